// What the Startup Suite and the History have in common: how they stand in the registry.
#include "modrig/lists/StoredList.h"

#include <algorithm>

#include "modrig/lists/Globals.h"
#include "modrig/lists/History.h"
#include "modrig/loader/StartupSuite.h"
#include "modrig/messages/MessageIds.h"
#include "tests/support/ModuleTest.h"

using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
using Operation = RecordingRegistry::Operation;

struct ListUnderTest
{
    const wchar_t* name; // "History"
    CStringList* list;
    void (*read)();
    void (*write)();
};

// Names the case in the list of tests; without it the name would hold addresses.
void PrintTo(const ListUnderTest& tested, std::ostream* stream)
{
    *stream << testing::PrintToString(std::wstring(tested.name));
}

class StoredList : public ModuleTest, public testing::WithParamInterface<ListUnderTest>
{
protected:
    static CStringList& list() { return *GetParam().list; }
    static void Read() { GetParam().read(); }
    static void Write() { GetParam().write(); }

    static std::wstring Key() { return host().moduleKey() + L"\\" + GetParam().name; }
    static std::wstring CountName() { return std::wstring(L"Num") + GetParam().name; }
    static std::wstring EntryName(std::size_t index) { return std::to_wstring(index) + GetParam().name; }

    static void Store(const std::wstring& name, const std::wstring& data)
    {
        host().registry.setValue(Key(), name, data);
    }
    static void StoreCount(const std::wstring& count) { Store(CountName(), count); }
    // Paths without a dot are listed and nothing else happens to them, in both lists.
    static void StoreEntries(std::initializer_list<const wchar_t*> paths)
    {
        std::size_t index = 0;
        for (const wchar_t* path : paths)
            Store(EntryName(++index), path);
    }
    static std::optional<std::wstring> Stored(const std::wstring& name)
    {
        return host().registry.value(Key(), name);
    }
    static std::vector<std::wstring> StoredNames() { return host().registry.valueNames(Key()); }

    // The first reads of the entry fail, as many as that; the ones after them go their way.
    static void FailFirstReadsOf(std::size_t entry, unsigned count)
    {
        host().registry.failWhen(
            [name = EntryName(entry), left = count](const RecordingRegistry::Call& call) mutable
            {
                if (left == 0 || call.operation != Operation::kRead || call.valueName != name)
                    return ERROR_SUCCESS;
                --left;
                return ERROR_ACCESS_DENIED;
            });
    }
    static std::size_t ReadsOf(std::size_t entry)
    {
        const std::vector<RecordingRegistry::Call> reads = host().registry.callsOf(Operation::kRead);
        return static_cast<std::size_t>(
            std::count_if(reads.begin(), reads.end(),
                          [name = EntryName(entry)](const RecordingRegistry::Call& call)
                          { return call.valueName == name; }));
    }

    static std::size_t TimesTheModulesKeyWasMade()
    {
        const std::vector<RecordingRegistry::Call> made = host().registry.callsOf(Operation::kCreate);
        return static_cast<std::size_t>(std::count_if(made.begin(), made.end(),
                                                      [](const RecordingRegistry::Call& call)
                                                      { return call.key == host().moduleKey(); }));
    }

    // The writes below the list's key fail for these value names.
    static void FailToWrite(std::vector<std::wstring> names)
    {
        host().registry.failWhen(
            [names = std::move(names)](const RecordingRegistry::Call& call)
            {
                const bool fails = call.operation == Operation::kWrite &&
                                   std::find(names.begin(), names.end(), call.valueName) != names.end();
                return fails ? ERROR_DISK_FULL : ERROR_SUCCESS;
            });
    }
    static void ExpectTheFailureIsReportedOnce()
    {
        EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kListNotStored, L"%s")))
            << "the text as it stands, without an argument";
    }
};
} // namespace

TEST_P(StoredList, IsReadInItsOrder)
{
    StoreCount(L"3");
    StoreEntries({L"/c", L"/a", L"/b"});
    Read();
    EXPECT_THAT(Texts(list()), ElementsAre(L"/c", L"/a", L"/b"));
}

TEST_P(StoredList, IsEmptyAfterReadingWithoutACount)
{
    Fill(list(), {L"/left/over"});
    StoreEntries({L"/a"});
    Read();
    EXPECT_TRUE(list().IsEmpty());
    EXPECT_THAT(boxes(), IsEmpty());
    EXPECT_THAT(lines(), IsEmpty());
}

TEST_P(StoredList, ReplacesWhatWasInTheList)
{
    Fill(list(), {L"/left/over"});
    StoreCount(L"1");
    StoreEntries({L"/a"});
    Read();
    EXPECT_THAT(Texts(list()), ElementsAre(L"/a"));
}

TEST_P(StoredList, EndsAtTheFirstGapInTheNumbering)
{
    StoreCount(L"3");
    Store(EntryName(1), L"/a");
    Store(EntryName(3), L"/c");
    Read();
    EXPECT_THAT(Texts(list()), ElementsAre(L"/a"));
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_P(StoredList, IsEmptyWhenTheFirstEntryIsMissing)
{
    StoreCount(L"3");
    Store(EntryName(0), L"/zero");
    Store(EntryName(2), L"/b");
    Read();
    EXPECT_TRUE(list().IsEmpty());
}

TEST_P(StoredList, HoldsTheSamePathInDifferentCaseOnceAndGoesOnAfterIt)
{
    StoreCount(L"3");
    StoreEntries({L"/a/Tool", L"/A/TOOL", L"/b"});
    Read();
    EXPECT_THAT(Texts(list()), ElementsAre(L"/a/Tool", L"/b"));
}

TEST_P(StoredList, ReadsNoMoreEntriesThanTheCountSays)
{
    StoreCount(L"1");
    StoreEntries({L"/a", L"/b"});
    Read();
    EXPECT_THAT(Texts(list()), ElementsAre(L"/a"));
}

TEST_P(StoredList, CountsADuplicateAmongThoseThatWereRead)
{
    StoreCount(L"2");
    StoreEntries({L"/a", L"/a", L"/b"});
    Read();
    EXPECT_THAT(Texts(list()), ElementsAre(L"/a"));
}

TEST_P(StoredList, TakesTheLeadingDigitsOfTheCount)
{
    const std::pair<const wchar_t*, std::size_t> counts[] = {{L"2 entries", 2}, {L"2x1", 2}, {L"", 0},
                                                             {L"two", 0},       {L"0", 0},   {L"-1", 0}};
    for (const auto& [text, expected] : counts)
    {
        StoreCount(text);
        StoreEntries({L"/a", L"/b", L"/c"});
        Read();
        EXPECT_EQ(expected, list().GetCount()) << testing::PrintToString(std::wstring(text));
    }
}

TEST_P(StoredList, LosesOneEntryToOnePassingFaultAndNotAllAfterIt)
{
    StoreCount(L"4");
    StoreEntries({L"/a", L"/b", L"/c", L"/d"});
    FailFirstReadsOf(2, 1);
    Read();
    EXPECT_THAT(Texts(list()), ElementsAre(L"/a", L"/b", L"/c")) << "the pass that failed is spent";
    EXPECT_EQ(2u, ReadsOf(2));
    EXPECT_EQ(0u, ReadsOf(4));
}

TEST_P(StoredList, SpendsEveryPassOfTheCountOnAGap)
{
    StoreCount(L"7");
    StoreEntries({L"/a", L"/b"});
    Read();
    EXPECT_THAT(Texts(list()), ElementsAre(L"/a", L"/b"));
    EXPECT_EQ(5u, ReadsOf(3));
    EXPECT_EQ(0u, ReadsOf(4));
}

TEST_P(StoredList, IsReadOnAfterAsManyFailedPassesInARowAsItBearsWith)
{
    StoreCount(L"20001");
    StoreEntries({L"/a", L"/b"});
    FailFirstReadsOf(1, 9999);
    Read();
    EXPECT_THAT(Texts(list()), ElementsAre(L"/a", L"/b"));
    EXPECT_EQ(10000u, ReadsOf(3)) << "the count of failed passes begins again after an entry";
}

TEST_P(StoredList, EndsAfterTenThousandFailedPassesInARow)
{
    StoreCount(L"20000");
    StoreEntries({L"/a", L"/b"});
    FailFirstReadsOf(2, 10000);
    Read();
    EXPECT_THAT(Texts(list()), ElementsAre(L"/a"));
    EXPECT_EQ(10000u, ReadsOf(2));
}

TEST_P(StoredList, TakesTheCountForADecimalNumber)
{
    for (std::size_t entry = 1; entry <= 12; ++entry)
        Store(EntryName(entry), L"/" + std::to_wstring(entry));
    const std::pair<const wchar_t*, std::size_t> counts[] = {{L"010", 10}, {L"0x3", 0}, {L"12", 12}};
    for (const auto& [text, expected] : counts)
    {
        StoreCount(text);
        Read();
        EXPECT_EQ(expected, list().GetCount()) << testing::PrintToString(std::wstring(text));
    }
}

TEST_P(StoredList, AsksForTheModulesKeyOnceHoweverManyEntriesItHas)
{
    Fill(list(), {L"/a", L"/b", L"/c"});
    Write();
    EXPECT_EQ(1u, TimesTheModulesKeyWasMade());
    Read();
    EXPECT_EQ(2u, TimesTheModulesKeyWasMade());
    EXPECT_EQ(3u, list().GetCount());
    Write();
    EXPECT_EQ(3u, TimesTheModulesKeyWasMade()) << "not for the values that are deleted either";
}

TEST_P(StoredList, DoesNotKeepTheStartWaitingForACountBeyondAllReason)
{
    StoreCount(L"99999999999999999999999");
    StoreEntries({L"/a", L"/b"});
    Read();
    EXPECT_THAT(Texts(list()), ElementsAre(L"/a", L"/b"));
    EXPECT_EQ(10000u, ReadsOf(3));
}

TEST_P(StoredList, IsReadFromDirectlyBelowTheUserWithoutAProfile)
{
    host().setProfile(L"");
    host().registry.setValue(GetParam().name, CountName(), L"1");
    host().registry.setValue(GetParam().name, EntryName(1), L"/a");
    Read();
    EXPECT_THAT(Texts(list()), ElementsAre(L"/a"));
}

TEST_P(StoredList, IsWrittenAsACountAndNumberedEntries)
{
    Fill(list(), {L"/c/tööl.lsp", L"/a b/100%s.lsp"});
    Write();
    EXPECT_THAT(StoredNames(), ElementsAre(CountName(), EntryName(1), EntryName(2)));
    EXPECT_EQ(L"2", Stored(CountName()));
    EXPECT_EQ(L"/c/tööl.lsp", Stored(EntryName(1)));
    EXPECT_EQ(L"/a b/100%s.lsp", Stored(EntryName(2)));
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_P(StoredList, IsWrittenAsACountOfZeroWhenItIsEmpty)
{
    Write();
    EXPECT_THAT(StoredNames(), ElementsAre(CountName()));
    EXPECT_EQ(L"0", Stored(CountName()));
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_P(StoredList, ReplacesALongerOneWholly)
{
    StoreCount(L"5");
    StoreEntries({L"/1", L"/2", L"/3", L"/4", L"/5"});
    Store(L"something else", L"x");
    Fill(list(), {L"/a", L"/b", L"/c"});
    Write();
    EXPECT_EQ(L"3", Stored(CountName()));
    EXPECT_THAT(StoredNames(), ElementsAre(CountName(), EntryName(1), EntryName(2), EntryName(3)));
}

TEST_P(StoredList, MakesTheKeyThenListsThenDeletesInListedOrderThenWritesTheCountAndTheEntries)
{
    Store(EntryName(2), L"/old2");
    StoreCount(L"2");
    Store(EntryName(1), L"/old1");
    Fill(list(), {L"/a", L"/b"});
    Write();
    std::vector<std::wstring> steps;
    for (const RecordingRegistry::Call& call : host().registry.calls())
    {
        if (call.key != Key() || call.operation == Operation::kClose)
            continue;
        const wchar_t* names[] = {L"open", L"make", L"list", L"delete", L"read", L"write", L"close"};
        steps.push_back(names[static_cast<std::size_t>(call.operation)] +
                        (call.valueName.empty() ? L"" : L" " + call.valueName));
    }
    EXPECT_THAT(steps, ElementsAre(L"make",                                     //
                                   L"open", L"list", L"list", L"list", L"list", //
                                   L"make", L"delete " + EntryName(2),          //
                                   L"make", L"delete " + CountName(),           //
                                   L"make", L"delete " + EntryName(1),          //
                                   L"make", L"write " + CountName(),            //
                                   L"make", L"write " + EntryName(1),           //
                                   L"make", L"write " + EntryName(2)));
}

TEST_P(StoredList, NeverTouchesTheUnnamedValue)
{
    Store(L"", L"somebody's");
    Fill(list(), {L"/a"});
    Write();
    EXPECT_EQ(L"somebody's", Stored(L""));
    EXPECT_EQ(L"1", Stored(CountName()));
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_P(StoredList, IgnoresWhatBecameOfMakingTheKey)
{
    host().registry.makeKey(Key());
    host().registry.failWhen(
        [failed = false, key = Key()](const RecordingRegistry::Call& call) mutable
        {
            const bool first = !failed && call.operation == Operation::kCreate && call.key == key;
            failed = failed || first;
            return first ? ERROR_WRITE_FAULT : ERROR_SUCCESS;
        });
    Fill(list(), {L"/a"});
    Write();
    EXPECT_EQ(L"1", Stored(CountName()));
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_P(StoredList, ReportsThatItsValuesCannotBeListed)
{
    StoreCount(L"1");
    host().registry.failWhen(
        [key = Key()](const RecordingRegistry::Call& call) {
            return call.operation == Operation::kOpen && call.key == key ? ERROR_ACCESS_DENIED
                                                                         : ERROR_SUCCESS;
        });
    Fill(list(), {L"/a", L"/b"});
    Write();
    ExpectTheFailureIsReportedOnce();
    EXPECT_THAT(host().registry.callsOf(Operation::kDelete), IsEmpty());
    EXPECT_THAT(host().registry.callsOf(Operation::kWrite), IsEmpty());
    EXPECT_EQ(L"1", Stored(CountName()));
}

TEST_P(StoredList, StopsAtTheFirstValueThatCannotBeDeleted)
{
    StoreCount(L"2");
    StoreEntries({L"/old1", L"/old2"});
    host().registry.failAfter(Operation::kDelete, 1, ERROR_WRITE_FAULT);
    Fill(list(), {L"/a"});
    Write();
    ExpectTheFailureIsReportedOnce();
    EXPECT_EQ(2u, host().registry.callsOf(Operation::kDelete).size());
    EXPECT_THAT(host().registry.callsOf(Operation::kWrite), IsEmpty());
    EXPECT_THAT(StoredNames(), ElementsAre(EntryName(1), EntryName(2))) << "the store holds what is left";
}

TEST_P(StoredList, WritesNoEntryWhenTheCountCannotBeWritten)
{
    FailToWrite({CountName()});
    Fill(list(), {L"/a", L"/b"});
    Write();
    ExpectTheFailureIsReportedOnce();
    EXPECT_EQ(1u, host().registry.callsOf(Operation::kWrite).size());
    EXPECT_THAT(StoredNames(), IsEmpty());
}

TEST_P(StoredList, GoesOnAfterAnEntryThatCannotBeWrittenAndReportsNothing)
{
    FailToWrite({EntryName(1), EntryName(2)});
    Fill(list(), {L"/a", L"/b", L"/c"});
    Write();
    EXPECT_THAT(boxes(), IsEmpty()) << "only the result of the last write counts";
    EXPECT_THAT(StoredNames(), ElementsAre(CountName(), EntryName(3)));
    EXPECT_EQ(L"/c", Stored(EntryName(3))) << "the numbers go on";
}

TEST_P(StoredList, ReportsThatItsLastEntryCannotBeWritten)
{
    FailToWrite({EntryName(3)});
    Fill(list(), {L"/a", L"/b", L"/c"});
    Write();
    ExpectTheFailureIsReportedOnce();
    EXPECT_EQ(L"3", Stored(CountName()));
    EXPECT_EQ(L"/b", Stored(EntryName(2)));
}

TEST_P(StoredList, ReportsAStoreThatCannotBeWrittenAtAll)
{
    host().registry.failAfter(Operation::kCreate, 0, ERROR_ACCESS_DENIED);
    Fill(list(), {L"/a"});
    Write();
    ExpectTheFailureIsReportedOnce();
}

TEST_P(StoredList, ComesBackAsItWasWritten)
{
    const std::initializer_list<const wchar_t*> paths = {L"/a b/tööl", L"C:\\x\\\"q\"", L"/100%s%n",
                                                         L"/чертёж"};
    Fill(list(), paths);
    Write();
    Read();
    EXPECT_THAT(Texts(list()), testing::ElementsAreArray(paths));
}

TEST_P(StoredList, ComesBackWithAllOfManyEntries)
{
    constexpr std::size_t kMany = 2500;
    for (std::size_t i = 1; i <= kMany; ++i)
        list().AddTail(CStdStr(L"/apps/" + std::to_wstring(i)));
    Write();
    Read();
    EXPECT_EQ(kMany, list().GetCount());
    EXPECT_EQ(L"2500", Stored(CountName()));
    EXPECT_EQ(L"/apps/2500", Stored(EntryName(kMany)));
}

TEST_P(StoredList, IsWrittenWithAPathOf4000CharactersAndEndsThereWhenItIsReadBack)
{
    const std::wstring path = LongPath(4000, L"tool");
    Fill(list(), {L"/a"});
    list().AddTail(CStdStr(path));
    Fill(list(), {L"/c"});
    Write();
    EXPECT_EQ(path, Stored(EntryName(2)));
    EXPECT_EQ(L"3", Stored(CountName()));
    EXPECT_THAT(boxes(), IsEmpty());
    Read();
    EXPECT_THAT(Texts(list()), ElementsAre(L"/a")) << "a value that cannot be read is a gap";
}

TEST_P(StoredList, ComesBackWithAPathOf1023Characters)
{
    const std::wstring path = LongPath(1023, L"tool");
    list().AddTail(CStdStr(path));
    Write();
    Read();
    EXPECT_THAT(Texts(list()), ElementsAre(path));
}

INSTANTIATE_TEST_SUITE_P(
    BothLists, StoredList,
    testing::Values(ListUnderTest{L"History", &gHistoryList, ModrigUtils::InitializeHistoryFiles,
                                  ModrigUtils::WriteHistoryFilesToRegistry},
                    ListUnderTest{L"Startup", &gStartupList, ModrigUtils::InitializeStartupFiles,
                                  ModrigUtils::WriteStartupFilesToRegistry}),
    [](const testing::TestParamInfo<ListUnderTest>& tested)
    {
        const std::wstring name = tested.param.name;
        return std::string(name.begin(), name.end());
    });
