// What SUITE and HISTORY do with a Modrig that is loaded, and what keeps them from changing anything. What a
// person sees of them is tested with the real host.
#include "modrig/commands/ListCommands.h"

#include <tessel/tsappinfo.h>
#include <tessel/tsedcommands.h>

#include "modrig/commands/CommandTexts.h"
#include "modrig/lists/Globals.h"
#include "modrig/lists/StoredList.h"
#include "modrig/messages/MessageIds.h"
#include "modrig/messages/ResourceOverride.h"
#include "tests/support/ModuleTest.h"

using namespace ModrigUtils;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::Optional;

namespace
{
const std::wstring kModrig = L"/plug-ins/Modrig.bundle";
constexpr const wchar_t* kTexts = L"ModrigLists.dll";
constexpr unsigned kAtStart = TSRX_LOAD_AT_HOST_START;
constexpr unsigned kOnCommand = TSRX_LOAD_ON_COMMAND;

constexpr struct
{
    const wchar_t* name;
    TsEdCommandHandler handler;
} kCommands[] = {{L"SUITE", RunSuite}, {L"HISTORY", RunHistory}};

class ListCommandsWithoutHost : public ModuleTest
{
protected:
    void SetUp() override
    {
        ModuleTest::SetUp();
        host().resources.addModule(kTexts, {{ModrigMessages::kHistoryName, L"the History"},
                                            {ModrigMessages::kStartupSuiteName, L"the Suite"},
                                            {ModrigMessages::kInStartupSuite, L"in the Suite"},
                                            {ModrigMessages::kListNotRead, L"unread: %s. %s"},
                                            {ModrigMessages::kListNotStored, L"not stored"},
                                            {ModrigMessages::kManyRemovedFromHistory, L"%s removed"},
                                            {ModrigMessages::kManyRemovedFromSuite, L"%s taken out"},
                                            {ModrigMessages::kOtherSessionRuns, L"another has %s"},
                                            {ModrigMessages::kModrigStays, L"Modrig keeps %s"},
                                            {ModrigMessages::kModrigIsOut, L"Modrig is out"}});
        CTemporaryResourceOverride::ReleaseDefaultResource();
        ASSERT_TRUE(CTemporaryResourceOverride::SetDefaultResource(0, CStdStr(kTexts)));
        for (const auto& [name, handler] : kCommands)
        {
            ASSERT_EQ(
                host().commands.addCommand(L"LISTS", name, name, 0, handler, nullptr, -1, nullptr, nullptr),
                TSED_COMMAND_OK);
            ASSERT_EQ(tsedTakeArguments(L"LISTS", name, L"..."), TSED_COMMAND_OK);
        }
        ASSERT_EQ(tsedOfferEntries(L"LISTS", L"SUITE", SuiteEntries), TSED_COMMAND_OK);
        ASSERT_EQ(tsedOfferEntries(L"LISTS", L"HISTORY", HistoryEntries), TSED_COMMAND_OK);
        Store(kStoredHistory);
        Store(kStoredStartupSuite);
    }

    static void Store(const StoredListNames& names)
    {
        CStringList list;
        Fill(list, {L"/a.lsp", L"/b.lsp"});
        ASSERT_TRUE(StoreList(names, list));
    }
    static std::vector<std::wstring> Stored(const StoredListNames& names)
    {
        CStringList list;
        ReadStoredList(names, list, [](const CStdStr&) {});
        return Texts(list);
    }

    // Of the registry's functions.
    static std::size_t CallsToList()
    {
        const std::size_t before = host().registry.calls().size();
        EXPECT_TRUE(host().commands.type(L"HISTORY LIST"));
        return host().registry.calls().size() - before;
    }

    static void RecordModrig(unsigned reasons)
    {
        host().applicationRecords.set({L"TesselModrig", kModrig, L"as it was", reasons});
    }
    static unsigned Recorded() { return host().applicationRecords.find(L"TesselModrig")->loadReason; }
};
} // namespace

TEST_F(ListCommandsWithoutHost, LeaveTheListToAModrigThatCannotGo)
{
    host().linker.setLoaded(kModrig);
    host().linker.refuseToUnload(kModrig);
    EXPECT_FALSE(host().commands.type(L"HISTORY CLEAR"));
    EXPECT_THAT(host().commands.failure, Optional(std::wstring(L"Modrig keeps the History")));
    EXPECT_THAT(Stored(kStoredHistory), ElementsAre(L"/a.lsp", L"/b.lsp"));
    EXPECT_TRUE(host().linker.isLoaded(kModrig));
    EXPECT_THAT(lines(), IsEmpty());
}

TEST_F(ListCommandsWithoutHost, LeaveModrigToItsCommandWhenItsRecordSaysSo)
{
    host().linker.setLoaded(kModrig);
    RecordModrig(kOnCommand);
    EXPECT_TRUE(host().commands.type(L"HISTORY CLEAR"));
    EXPECT_FALSE(host().linker.isLoaded(kModrig));
    EXPECT_THAT(Stored(kStoredHistory), IsEmpty());
    EXPECT_THAT(lines(), ElementsAre(L"2 removed", L"Modrig is out"));
}

TEST_F(ListCommandsWithoutHost, LoadModrigAgainWhenTheListIsStoredAndNoCommandWouldDoSo)
{
    for (const bool isRecorded : {false, true})
    {
        Store(kStoredHistory);
        if (isRecorded)
            RecordModrig(kAtStart);
        std::vector<std::wstring> foundAtLoad = {L"not loaded"};
        host().linker.setLoaded(kModrig);
        host().linker.setEntryPoint(kModrig,
                                    [&](unsigned message, void*)
                                    {
                                        if (message == TSRX_MSG_LOAD)
                                            foundAtLoad = Stored(kStoredHistory);
                                        return TSRX_RET_OK;
                                    });
        EXPECT_TRUE(host().commands.type(L"HISTORY CLEAR"));
        EXPECT_TRUE(host().linker.isLoaded(kModrig));
        EXPECT_THAT(foundAtLoad, IsEmpty());
    }
    EXPECT_THAT(lines(), ElementsAre(L"2 removed", L"2 removed"));
}

TEST_F(ListCommandsWithoutHost, DisturbNobodyWhileAnotherSessionRuns)
{
    host().linker.setLoaded(kModrig);
    host().session.otherSessionRuns = true;
    EXPECT_FALSE(host().commands.type(L"SUITE CLEAR"));
    EXPECT_THAT(host().commands.failure, Optional(std::wstring(L"another has the Suite")));
    EXPECT_THAT(Stored(kStoredStartupSuite), ElementsAre(L"/a.lsp", L"/b.lsp"));
    EXPECT_THAT(host().linker.calls, IsEmpty());
    EXPECT_TRUE(host().commands.type(L"SUITE LIST"));
}

// Lists may be long.
TEST_F(ListCommandsWithoutHost, ReadAnEntryOnceToListIt)
{
    const std::size_t callsForTwo = CallsToList();
    CStringList longer;
    Fill(longer, {L"/a.lsp", L"/b.lsp", L"/c.lsp", L"/d.lsp"});
    ASSERT_TRUE(StoreList(kStoredHistory, longer));
    constexpr std::size_t kOpenReadAndClose = 3;
    EXPECT_EQ(CallsToList() - callsForTwo, 2 * kOpenReadAndClose);
}

// A store may have room for the list in memory, and find none on the disk.
TEST_F(ListCommandsWithoutHost, FailWhenWhatWasWrittenCannotBeStored)
{
    host().registry.failAfter(RecordingRegistry::Operation::kFlush, 0);
    EXPECT_FALSE(host().commands.type(L"HISTORY CLEAR"));
    EXPECT_THAT(host().commands.failure, Optional(std::wstring(L"not stored")));
    EXPECT_THAT(lines(), IsEmpty());
}

TEST_F(ListCommandsWithoutHost, FailWithoutABoxWhenTheListCannotBeStored)
{
    RecordModrig(kAtStart | kOnCommand);
    host().registry.failAfter(RecordingRegistry::Operation::kDelete, 0);
    EXPECT_FALSE(host().commands.type(L"SUITE CLEAR"));
    EXPECT_THAT(host().commands.failure, Optional(std::wstring(L"not stored")));
    EXPECT_THAT(boxes(), IsEmpty());
    EXPECT_THAT(lines(), IsEmpty());
    EXPECT_EQ(Recorded(), kAtStart | kOnCommand);
}

TEST_F(ListCommandsWithoutHost, LetTheRecordOfModrigFollowTheSuiteAlone)
{
    RecordModrig(kAtStart | kOnCommand);
    EXPECT_TRUE(host().commands.type(L"HISTORY CLEAR"));
    EXPECT_THAT(host().applicationRecords.writes, IsEmpty());
    EXPECT_TRUE(host().commands.type(L"SUITE CLEAR"));
    EXPECT_EQ(Recorded(), kOnCommand);
    ASSERT_EQ(host().applicationRecords.writes.size(), 1U);
    EXPECT_FALSE(host().applicationRecords.writes[0].withCommands) << "they are Modrig's";
    EXPECT_FALSE(host().applicationRecords.writes[0].forAllUsers);
}

TEST_F(ListCommandsWithoutHost, WriteNoRecordThatIsAsItShouldBe)
{
    RecordModrig(kAtStart | kOnCommand);
    EXPECT_TRUE(host().commands.type(L"SUITE REMOVE /a.lsp"));
    EXPECT_THAT(host().applicationRecords.writes, IsEmpty());
}

TEST_F(ListCommandsWithoutHost, DisturbNobodyAndStoreNothingWhereTheListCannotBeRead)
{
    RecordModrig(kAtStart | kOnCommand);
    host().linker.setLoaded(kModrig);
    host().registry.whyUnreadable = L"It is torn.";
    EXPECT_FALSE(host().commands.type(L"SUITE CLEAR"));
    EXPECT_THAT(host().commands.failure, Optional(std::wstring(L"unread: in the Suite. It is torn.")));
    EXPECT_THAT(Stored(kStoredStartupSuite), ElementsAre(L"/a.lsp", L"/b.lsp"));
    EXPECT_THAT(host().linker.calls, IsEmpty());
    EXPECT_EQ(Recorded(), kAtStart | kOnCommand);
    EXPECT_THAT(lines(), IsEmpty());
}

TEST_F(ListCommandsWithoutHost, OfferWhatIsStored)
{
    CStringList one;
    Fill(one, {L"/one.lsp"});
    ASSERT_TRUE(StoreList(kStoredHistory, one));
    EXPECT_THAT(host().commands.offered(L"SUITE", {L"REMOVE"}), ElementsAre(L"/a.lsp", L"/b.lsp"));
    EXPECT_THAT(host().commands.offered(L"HISTORY", {L"REMOVE"}), ElementsAre(L"/one.lsp"));
    EXPECT_THAT(lines(), IsEmpty());
}
