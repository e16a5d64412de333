#include "modrig/profile/ProfileRegistry.h"

#include "tests/support/ModuleTest.h"

using namespace ModrigUtils;
using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
using Operation = RecordingRegistry::Operation;

constexpr const wchar_t* kProfiles = L"Software\\Tessel\\R21\\Profiles";
constexpr const wchar_t* kKey = L"Software\\Tests";

class ProfileRegistry : public ModuleTest
{
protected:
    static RecordingRegistry& registry() { return host().registry; }

    static std::vector<Operation> Operations()
    {
        std::vector<Operation> operations;
        for (const RecordingRegistry::Call& call : registry().calls())
            operations.push_back(call.operation);
        return operations;
    }
    static bool Read(const std::wstring& name, CStdStr& data)
    {
        return ReadModrigRegString(HKEY_CURRENT_USER, kKey, CStdStr(name), data);
    }
    static bool Write(const std::wstring& name, const std::wstring& data)
    {
        return WriteModrigRegString(HKEY_CURRENT_USER, kKey, CStdStr(name), CStdStr(data));
    }
    static bool Delete(const std::wstring& name)
    {
        return DeleteModrigRegString(HKEY_CURRENT_USER, kKey, CStdStr(name));
    }
};

class ModuleKey : public ProfileRegistry
{
};

class RememberedFolder : public ProfileRegistry
{
protected:
    static bool Remember(signed char mainDialog, const std::wstring& folder)
    {
        CStdStr directory(folder);
        return SetRegModrigDirectory(1, mainDialog, directory);
    }
    static bool Recall(signed char mainDialog, CStdStr& directory)
    {
        return SetRegModrigDirectory(0, mainDialog, directory);
    }
};
} // namespace

TEST_F(ModuleKey, LiesBelowTheCurrentProfile)
{
    host().setProfile(L"My profile");
    EXPECT_EQ(L"Software\\Tessel\\R21\\Profiles\\My profile\\Dialogs\\Modrig",
              GetModrigProfileRegKey().Text());
}

TEST_F(ModuleKey, LiesBelowTheRootThatTheHostReports)
{
    host().applicationServices.registryRoot = L"Software\\Other\\R5";
    registry().setValue(L"Software\\Other\\R5\\Profiles", L"", L"p");
    EXPECT_EQ(L"Software\\Other\\R5\\Profiles\\p\\Dialogs\\Modrig", GetModrigProfileRegKey().Text());
}

TEST_F(ModuleKey, IsMadeWithItsParentAndStaysTheSame)
{
    const std::wstring key = GetModrigProfileRegKey().Text();
    const std::wstring dialogs = std::wstring(kProfiles) + L"\\Default\\Dialogs";
    EXPECT_TRUE(registry().hasKey(dialogs));
    EXPECT_TRUE(registry().hasKey(key));
    EXPECT_THAT(registry().valueNames(dialogs), IsEmpty()) << "the unnamed value stays unset";
    EXPECT_THAT(registry().valueNames(key), IsEmpty());
    EXPECT_EQ(key, GetModrigProfileRegKey().Text());
}

TEST_F(ModuleKey, IsMadeAgainOnEveryCall)
{
    EXPECT_EQ(GetModrigProfileRegKey(), GetModrigProfileRegKey());
    std::vector<std::wstring> made;
    for (const RecordingRegistry::Call& call : registry().callsOf(Operation::kCreate))
        made.push_back(call.key);
    const std::wstring dialogs = std::wstring(kProfiles) + L"\\Default\\Dialogs";
    EXPECT_THAT(made, ElementsAre(dialogs, dialogs + L"\\Modrig", dialogs, dialogs + L"\\Modrig"));
}

TEST_F(ModuleKey, IsEmptyAndMakesNothingWithoutACurrentProfile)
{
    host().setProfile(L"");
    const std::vector<std::wstring> before = registry().keys();
    EXPECT_TRUE(GetModrigProfileRegKey().IsEmpty());
    EXPECT_EQ(before, registry().keys());
    EXPECT_THAT(registry().callsOf(Operation::kCreate), IsEmpty());
}

TEST_F(ModuleKey, IsEmptyWhenTheProfileCannotBeRead)
{
    registry().failAfter(Operation::kRead, 0, ERROR_ACCESS_DENIED);
    EXPECT_TRUE(GetModrigProfileRegKey().IsEmpty());
    EXPECT_THAT(registry().callsOf(Operation::kCreate), IsEmpty());
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(ModuleKey, IsAnsweredAlsoWhenItCannotBeMade)
{
    registry().failAfter(Operation::kCreate, 0, ERROR_ACCESS_DENIED);
    EXPECT_EQ(host().moduleKey(), GetModrigProfileRegKey().Text());
}

TEST_F(ModuleKey, DoesNotCrashBeforeTheHostHasItsServices)
{
    host().applicationServices.exist = false;
    EXPECT_TRUE(GetModrigProfileRegKey().IsEmpty());
}

TEST_F(ProfileRegistry, ReadsAValueWithReadAccessAndClosesTheKey)
{
    registry().setValue(kKey, L"name", L"dätä");
    CStdStr data(L"before");
    EXPECT_TRUE(Read(L"NAME", data));
    EXPECT_EQ(L"dätä", data.Text());
    EXPECT_THAT(Operations(), ElementsAre(Operation::kOpen, Operation::kRead, Operation::kClose));
    EXPECT_EQ(0x20019u, registry().calls().front().access);
}

TEST_F(ProfileRegistry, ReadsAnEmptyValueAndTheUnnamedOne)
{
    registry().setValue(kKey, L"empty", L"");
    registry().setValue(kKey, L"", L"unnamed");
    CStdStr data(L"before");
    EXPECT_TRUE(Read(L"empty", data));
    EXPECT_EQ(L"", data.Text());
    EXPECT_TRUE(Read(L"", data));
    EXPECT_EQ(L"unnamed", data.Text());
}

TEST_F(ProfileRegistry, ReadsNothingFromAKeyOrAValueThatIsMissing)
{
    CStdStr data(L"before");
    EXPECT_FALSE(Read(L"name", data));
    EXPECT_FALSE(registry().hasKey(kKey)) << "reading makes no key";
    registry().makeKey(kKey);
    EXPECT_FALSE(Read(L"name", data));
    EXPECT_EQ(L"before", data.Text());
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(ProfileRegistry, ReadsAValueOf1023CharactersAndNoLongerOne)
{
    registry().setValue(kKey, L"longest", std::wstring(1023, L'x'));
    registry().setValue(kKey, L"too long", std::wstring(1024, L'x'));
    CStdStr data;
    EXPECT_TRUE(Read(L"longest", data));
    EXPECT_EQ(1023u, data.Text().size());
    EXPECT_FALSE(Read(L"too long", data));
    EXPECT_EQ(1023u, data.Text().size());
}

TEST_F(ProfileRegistry, WritesAValueWithWriteAccessAndClosesTheKey)
{
    EXPECT_TRUE(Write(L"name", L"data %s"));
    EXPECT_EQ(L"data %s", registry().value(kKey, L"name"));
    EXPECT_THAT(Operations(), ElementsAre(Operation::kCreate, Operation::kWrite, Operation::kClose));
    EXPECT_EQ(0x20006u, registry().calls().front().access);
}

TEST_F(ProfileRegistry, WritesAValueThatIsTooLongToBeReadBack)
{
    const std::wstring data(4000, L'x');
    EXPECT_TRUE(Write(L"name", data));
    EXPECT_EQ(data, registry().value(kKey, L"name"));
}

TEST_F(ProfileRegistry, MakesTheKeyOnlyWhenWritingWithoutAName)
{
    EXPECT_TRUE(Write(L"", L"never stored"));
    EXPECT_TRUE(registry().hasKey(kKey));
    EXPECT_FALSE(registry().value(kKey, L"").has_value());
    EXPECT_THAT(Operations(), ElementsAre(Operation::kCreate, Operation::kClose));
}

TEST_F(ProfileRegistry, LeavesAnUnnamedValueThatIsThereWhenWritingWithoutAName)
{
    registry().setValue(kKey, L"", L"the host's");
    EXPECT_TRUE(Write(L"", L"never stored"));
    EXPECT_EQ(L"the host's", registry().value(kKey, L""));
}

TEST_F(ProfileRegistry, AnswersFalseWhenAValueOrItsKeyCannotBeWritten)
{
    registry().failAfter(Operation::kWrite, 0, ERROR_DISK_FULL);
    EXPECT_FALSE(Write(L"name", L"data"));
    EXPECT_TRUE(Write(L"", L""));
    registry().failAfter(Operation::kCreate, 0, ERROR_ACCESS_DENIED);
    EXPECT_FALSE(Write(L"name", L"data"));
    EXPECT_FALSE(Write(L"", L""));
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(ProfileRegistry, DeletesAValueWithWriteAccessAndClosesTheKey)
{
    registry().setValue(kKey, L"name", L"data");
    EXPECT_TRUE(Delete(L"name"));
    EXPECT_FALSE(registry().value(kKey, L"name").has_value());
    EXPECT_THAT(Operations(), ElementsAre(Operation::kCreate, Operation::kDelete, Operation::kClose));
    EXPECT_EQ(0x20006u, registry().calls().front().access);
}

TEST_F(ProfileRegistry, AnswersFalseWhenThereIsNoValueToDelete)
{
    registry().makeKey(kKey);
    EXPECT_FALSE(Delete(L"name"));
}

TEST_F(ProfileRegistry, MakesAMissingKeyWhenDeleting)
{
    EXPECT_FALSE(Delete(L"name"));
    EXPECT_TRUE(registry().hasKey(kKey));
}

TEST_F(ProfileRegistry, DeletesNothingWithoutAName)
{
    registry().setValue(kKey, L"", L"the host's");
    EXPECT_TRUE(Delete(L""));
    EXPECT_EQ(L"the host's", registry().value(kKey, L""));
    EXPECT_THAT(Operations(), ElementsAre(Operation::kCreate, Operation::kClose));
}

TEST_F(ProfileRegistry, AnswersFalseWhenTheKeyCannotBeOpenedForDeleting)
{
    registry().setValue(kKey, L"name", L"data");
    registry().failAfter(Operation::kCreate, 0, ERROR_ACCESS_DENIED);
    EXPECT_FALSE(Delete(L"name"));
    EXPECT_FALSE(Delete(L""));
    EXPECT_TRUE(registry().value(kKey, L"name").has_value());
}

TEST_F(ProfileRegistry, ListsTheNamesOfTheValuesInTheStoresOrder)
{
    for (const wchar_t* name : {L"b", L"a", L"ä %s"})
        registry().setValue(kKey, name, L"data");
    CStringList names;
    Fill(names, {L"what was there before"});
    EXPECT_TRUE(EnumModrigRegString(HKEY_CURRENT_USER, kKey, names));
    EXPECT_THAT(Texts(names), ElementsAre(L"b", L"a", L"ä %s"));
    EXPECT_EQ(0x20019u, registry().calls().front().access);
    EXPECT_EQ(Operation::kClose, registry().calls().back().operation);
}

TEST_F(ProfileRegistry, EmptiesTheListAlsoWhenThereIsNoKey)
{
    CStringList names;
    Fill(names, {L"what was there before"});
    EXPECT_FALSE(EnumModrigRegString(HKEY_CURRENT_USER, kKey, names));
    EXPECT_TRUE(names.IsEmpty());
    EXPECT_FALSE(registry().hasKey(kKey));
}

TEST_F(ProfileRegistry, ListsNothingForAKeyWithoutValues)
{
    registry().makeKey(kKey);
    CStringList names;
    EXPECT_TRUE(EnumModrigRegString(HKEY_CURRENT_USER, kKey, names));
    EXPECT_TRUE(names.IsEmpty());
}

TEST_F(ProfileRegistry, GoesOnListingAfterAValueThatCannotBeNamed)
{
    for (const wchar_t* name : {L"a", L"b", L"c"})
        registry().setValue(kKey, name, L"data");
    registry().failWhen(
        [](const RecordingRegistry::Call& call)
        {
            const bool second = call.operation == Operation::kEnumerate && call.index == 1;
            return second ? ERROR_MORE_DATA : ERROR_SUCCESS;
        });
    CStringList names;
    EXPECT_TRUE(EnumModrigRegString(HKEY_CURRENT_USER, kKey, names));
    EXPECT_THAT(Texts(names), ElementsAre(L"a", L"", L"c")) << "only the end of the values ends the walk";
}

TEST_F(ProfileRegistry, ListsANameOf1023CharactersWhole)
{
    const std::wstring name(1023, L'n');
    registry().setValue(kKey, name, L"data");
    registry().setValue(kKey, L"next", L"data");
    CStringList names;
    EXPECT_TRUE(EnumModrigRegString(HKEY_CURRENT_USER, kKey, names));
    EXPECT_THAT(Texts(names), ElementsAre(name, L"next"));
}

TEST_F(ProfileRegistry, OpensAKeyForReadingWithNothingReserved)
{
    CStdStr data;
    Read(L"name", data);
    CStringList names;
    static_cast<void>(EnumModrigRegString(HKEY_CURRENT_USER, kKey, names)); // there is nothing
    const std::vector<RecordingRegistry::Call> opened = registry().callsOf(Operation::kOpen);
    ASSERT_EQ(2u, opened.size());
    for (const RecordingRegistry::Call& call : opened)
    {
        EXPECT_EQ(0u, call.reserved);
        EXPECT_EQ(0x20019u, call.access);
    }
}

TEST_F(ProfileRegistry, MakesAKeyWithoutClassOptionsOrSecurityAndAsksForNoMoreThanTheKey)
{
    Write(L"name", L"data");
    Delete(L"name");
    const std::vector<RecordingRegistry::Call> made = registry().callsOf(Operation::kCreate);
    ASSERT_EQ(2u, made.size());
    for (const RecordingRegistry::Call& call : made)
    {
        EXPECT_EQ(0u, call.reserved);
        EXPECT_FALSE(call.keyClass.has_value());
        EXPECT_EQ(0u, call.options);
        EXPECT_EQ(0x20006u, call.access);
        EXPECT_FALSE(call.hasSecurity);
        EXPECT_FALSE(call.asksForDisposition);
    }
}

TEST_F(ProfileRegistry, AsksForAStringOfUpTo4096Bytes)
{
    registry().makeKey(kKey);
    CStdStr data;
    Read(L"name", data);
    const std::vector<RecordingRegistry::Call> reads = registry().callsOf(Operation::kRead);
    ASSERT_EQ(1u, reads.size());
    EXPECT_EQ(REG_SZ, reads.front().type);
    EXPECT_EQ(4096u, reads.front().size);
    EXPECT_EQ(0u, reads.front().reserved);
}

TEST_F(ProfileRegistry, AsksForEachNameWithRoomFor1024CharactersAndForNothingElse)
{
    registry().setValue(kKey, L"first and longer", L"data");
    registry().setValue(kKey, L"second", L"data");
    CStringList names;
    EXPECT_TRUE(EnumModrigRegString(HKEY_CURRENT_USER, kKey, names));
    const std::vector<RecordingRegistry::Call> asked = registry().callsOf(Operation::kEnumerate);
    ASSERT_EQ(3u, asked.size());
    for (const RecordingRegistry::Call& call : asked)
    {
        EXPECT_EQ(1024u, call.size) << "the room is told again each time";
        EXPECT_FALSE(call.asksForData);
    }
}

TEST_F(ProfileRegistry, WorksBelowTheRootThatItIsGiven)
{
    registry().setValue(L"Other\\Settings", L"name", L"below the other");
    registry().setValue(L"Settings", L"name", L"below the user");
    HKEY other = nullptr;
    ASSERT_EQ(ERROR_SUCCESS, RegOpenKeyExW(HKEY_CURRENT_USER, L"Other", 0, KEY_READ, &other));
    CStdStr data;
    EXPECT_TRUE(ReadModrigRegString(other, L"Settings", L"name", data));
    EXPECT_EQ(L"below the other", data.Text());
    EXPECT_TRUE(WriteModrigRegString(other, L"Settings", L"second", L"written"));
    EXPECT_EQ(L"written", registry().value(L"Other\\Settings", L"second"));
    CStringList names;
    EXPECT_TRUE(EnumModrigRegString(other, L"Settings", names));
    EXPECT_THAT(Texts(names), ElementsAre(L"name", L"second"));
    EXPECT_TRUE(DeleteModrigRegString(other, L"Settings", L"name"));
    EXPECT_FALSE(registry().value(L"Other\\Settings", L"name").has_value());
    EXPECT_EQ(L"below the user", registry().value(L"Settings", L"name"));
    RegCloseKey(other);
}

TEST_F(RememberedFolder, IsEmptyWhenAnEmptyOneIsStored)
{
    registry().setValue(host().moduleKey(), L"MainDialog", L"");
    CStdStr directory(L"/where/it/was");
    EXPECT_TRUE(Recall(1, directory));
    EXPECT_EQ(L"", directory.Text());
}

TEST_F(RememberedFolder, IsKeptForEachDialogByItself)
{
    EXPECT_TRUE(Remember(1, L"/apps/main"));
    EXPECT_TRUE(Remember(0, L"/apps/add"));
    EXPECT_EQ(L"/apps/main", registry().value(host().moduleKey(), L"MainDialog"));
    EXPECT_EQ(L"/apps/add", registry().value(host().moduleKey(), L"AddAppDialog"));
    CStdStr directory;
    EXPECT_TRUE(Recall(1, directory));
    EXPECT_EQ(L"/apps/main", directory.Text());
    EXPECT_TRUE(Recall(0, directory));
    EXPECT_EQ(L"/apps/add", directory.Text());
}

TEST_F(RememberedFolder, TakesAnyNonZeroFlagForYes)
{
    CStdStr directory(L"/apps");
    EXPECT_TRUE(SetRegModrigDirectory(-1, 2, directory));
    EXPECT_EQ(L"/apps", registry().value(host().moduleKey(), L"MainDialog"));
}

TEST_F(RememberedFolder, LeavesTheCallersTextWhenNoneIsStored)
{
    CStdStr directory(L"/where/it/was");
    EXPECT_FALSE(Recall(1, directory));
    EXPECT_EQ(L"/where/it/was", directory.Text());
}

TEST_F(RememberedFolder, IsNotStoredWhenItIsEmpty)
{
    Remember(1, L"/apps");
    EXPECT_FALSE(Remember(1, L""));
    EXPECT_EQ(L"/apps", registry().value(host().moduleKey(), L"MainDialog"));
    EXPECT_EQ(1u, registry().callsOf(Operation::kWrite).size());
}

TEST_F(RememberedFolder, CountsAsStoredWhateverTheStoreAnswered)
{
    registry().failAfter(Operation::kWrite, 0, ERROR_DISK_FULL);
    EXPECT_TRUE(Remember(1, L"/apps"));
    registry().failAfter(Operation::kCreate, 0, ERROR_ACCESS_DENIED);
    EXPECT_TRUE(Remember(1, L"/apps"));
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(RememberedFolder, StandsDirectlyBelowTheUserWithoutAProfile)
{
    host().setProfile(L"");
    EXPECT_TRUE(Remember(1, L"/apps"));
    EXPECT_EQ(L"/apps", registry().value(L"", L"MainDialog"));
}
