#include "host/registry/Registry.h"

#include <gmock/gmock.h>

#include "host/registry/Profiles.h"
#include "tests/host/registry/StoredList.h"
#include "tests/host/support/RegistryHost.h"

using tessel::Registry;
using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
class RegistryStore : public testing::Test
{
protected:
    Registry& registry() { return host.registry(); }

    std::vector<std::wstring> valueNames(const wchar_t* path)
    {
        std::vector<std::wstring> names;
        for (const auto& value : registry().values(registry().find(path)))
            names.push_back(value.name);
        return names;
    }

    RegistryHost host;
};
} // namespace

TEST_F(RegistryStore, KeepsWhatACommandWrote)
{
    EXPECT_EQ(registry().canStore().sentence(), L"");
    EXPECT_TRUE(registry().write(L"Software\\Tessel", L"name", L"größe \U0001F600"));
    EXPECT_TRUE(registry().endOfCommand());
    host.open();
    EXPECT_EQ(registry().read(L"Software\\Tessel", L"name"), L"größe \U0001F600");
    EXPECT_EQ(host.output().text(), "");
}

TEST_F(RegistryStore, StoresTheRestWhenItIsClosed)
{
    EXPECT_TRUE(registry().write(L"A", L"name", L"data"));
    host.open();
    EXPECT_EQ(registry().read(L"A", L"name"), L"data");
}

TEST_F(RegistryStore, HasNothingWhereNothingWasWritten)
{
    EXPECT_EQ(registry().find(L"A"), Registry::kNoKey);
    EXPECT_EQ(registry().read(L"A", L"name"), std::nullopt);
    EXPECT_TRUE(registry().write(L"A", L"name", L""));
    EXPECT_EQ(registry().read(L"A", L"other"), std::nullopt);
    EXPECT_EQ(registry().read(L"A", L""), std::nullopt);
    EXPECT_EQ(registry().read(L"A", L"name"), L"");
}

TEST_F(RegistryStore, ComparesNamesWithoutRegardToCaseInEveryScript)
{
    EXPECT_TRUE(registry().write(L"Büro\\ЖУК", L"Größe", L"1"));
    EXPECT_EQ(registry().read(L"BÜRO\\жук", L"GRÖßE"), L"1");
    EXPECT_TRUE(registry().write(L"büro\\Жук", L"größe", L"2"));
    const auto values = registry().values(registry().find(L"büro\\жук"));
    ASSERT_EQ(values.size(), 1u);
    EXPECT_EQ(values[0].name, L"Größe");
    EXPECT_EQ(values[0].data, L"2");
    EXPECT_THAT(registry().subKeys(Registry::kRoot), ElementsAre(L"Büro"));
    EXPECT_EQ(registry().read(L"BÜRO\\ЖУК", L"GROSSE"), std::nullopt);
}

TEST_F(RegistryStore, EnumeratesInTheOrderOfCreation)
{
    for (const wchar_t* name : {L"zebra", L"10History", L"9History", L"Äpfel", L"apple"})
    {
        EXPECT_TRUE(registry().write(L"Values", name, L"1"));
        EXPECT_TRUE(registry().write(std::wstring(L"Keys\\") + name, L"", L""));
    }
    EXPECT_TRUE(registry().write(L"Values", L"9HISTORY", L"2"));
    EXPECT_TRUE(registry().write(L"Keys\\APPLE", L"", L"2"));
    host.open();
    EXPECT_THAT(valueNames(L"Values"), ElementsAre(L"zebra", L"10History", L"9History", L"Äpfel", L"apple"));
    EXPECT_THAT(registry().subKeys(registry().find(L"Keys")),
                ElementsAre(L"zebra", L"10History", L"9History", L"Äpfel", L"apple"));
}

TEST_F(RegistryStore, PutsAValueThatWasRemovedAtTheEnd)
{
    for (const wchar_t* name : {L"a", L"b", L"c"})
        EXPECT_TRUE(registry().write(L"K", name, L""));
    const auto key = registry().find(L"K");
    EXPECT_EQ(registry().removeValue(key, L"A").code(), ERROR_SUCCESS);
    EXPECT_EQ(registry().removeValue(key, L"A").code(), ERROR_FILE_NOT_FOUND);
    EXPECT_TRUE(registry().write(L"K", L"A", L""));
    EXPECT_THAT(valueNames(L"K"), ElementsAre(L"b", L"c", L"A"));
}

TEST_F(RegistryStore, PassesOverEmptyPartsOfAPath)
{
    EXPECT_TRUE(registry().write(L"\\A\\\\B\\", L"name", L"1"));
    EXPECT_EQ(registry().read(L"A\\B", L"name"), L"1");
    EXPECT_EQ(registry().find(L""), Registry::kRoot);
    EXPECT_EQ(registry().find(L"\\\\\\"), Registry::kRoot);
    EXPECT_EQ(registry().find(L"A/B"), Registry::kNoKey);
}

TEST_F(RegistryStore, KeepsNamesAndDataOfEveryKind)
{
    const std::wstring data(4000, L'ß');
    const std::wstring name = L"100%s '; DROP TABLE value; -- \"" + std::wstring(500, L'n');
    EXPECT_TRUE(registry().write(L"it's a \"key\" 50%", name, data));
    host.open();
    EXPECT_EQ(registry().read(L"IT'S A \"KEY\" 50%", name), data);
}

TEST_F(RegistryStore, RemovesAKeyWithAllThatIsBelowIt)
{
    EXPECT_TRUE(registry().write(L"A\\B\\C", L"name", L"1"));
    EXPECT_TRUE(registry().write(L"A\\D", L"name", L"1"));
    EXPECT_EQ(registry().removeKey(registry().find(L"A\\B")).code(), ERROR_SUCCESS);
    EXPECT_EQ(registry().find(L"A\\B"), Registry::kNoKey);
    EXPECT_EQ(registry().find(L"A\\B\\C"), Registry::kNoKey);
    EXPECT_TRUE(registry().write(L"A\\B\\C", L"other", L"1"));
    EXPECT_THAT(valueNames(L"A\\B\\C"), ElementsAre(L"other"));
    EXPECT_THAT(registry().subKeys(registry().find(L"A")), ElementsAre(L"D", L"B"));
}

TEST_F(RegistryStore, KeepsItsRoot)
{
    EXPECT_TRUE(registry().write(L"A", L"name", L"1"));
    EXPECT_EQ(registry().removeKey(Registry::kRoot).code(), ERROR_INVALID_PARAMETER);
    EXPECT_EQ(registry().removeKey(Registry::kNoKey).code(), ERROR_INVALID_PARAMETER);
    EXPECT_EQ(registry().read(L"A", L"name"), L"1");
    EXPECT_EQ(registry().find(L"HKEY_CURRENT_USER"), Registry::kNoKey);
}

TEST_F(RegistryStore, NeverGivesTheNumberOfARemovedKeyToAnother)
{
    const auto removed = registry().create(L"A", Registry::kRoot);
    ASSERT_EQ(removed.code(), ERROR_SUCCESS);
    EXPECT_EQ(registry().removeKey(*removed).code(), ERROR_SUCCESS);
    EXPECT_TRUE(registry().endOfCommand());
    const auto other = registry().create(L"B", Registry::kRoot);
    ASSERT_EQ(other.code(), ERROR_SUCCESS);
    EXPECT_NE(*other, *removed);
}

TEST_F(RegistryStore, UndoesTheWholeCommandAfterAWriteThatFailed)
{
    EXPECT_TRUE(registry().write(L"A", L"name", L"before"));
    EXPECT_TRUE(registry().endOfCommand());
    EXPECT_TRUE(registry().write(L"A", L"name", L"after"));
    EXPECT_TRUE(registry().write(L"New", L"name", L"after"));
    const HKEY older = registry().openHandle(registry().find(L"New"));
    const HKEY handle = registry().openHandle(registry().find(L"New"));
    EXPECT_EQ(registry().writeValue(999'999, L"name", L"no such key").code(), ERROR_WRITE_FAULT);
    EXPECT_EQ(registry().read(L"A", L"name"), L"before") << "what is stored is read from then on";
    EXPECT_FALSE(registry().write(L"A", L"name", L"later")) << "the rest of the command fails too";
    EXPECT_EQ(registry().keyOf(handle), std::nullopt) << "a key that was undone has no handle";
    EXPECT_EQ(registry().keyOf(older), std::nullopt);
    EXPECT_FALSE(host.output().commandLine().tell(registry().endOfCommand()));
    EXPECT_EQ(host.output().text(), "The registry " + host.file().string() +
                                        " could not be written: FOREIGN KEY constraint failed. What was "
                                        "stored before is unchanged.\n");
    EXPECT_EQ(registry().find(L"New"), Registry::kNoKey);
    EXPECT_TRUE(registry().write(L"A", L"name", L"the next command"));
    EXPECT_TRUE(registry().endOfCommand());
    host.open();
    EXPECT_EQ(registry().read(L"A", L"name"), L"the next command");
}

TEST_F(RegistryStore, WalksALongListInBothDirectionsAndByLeaps)
{
    ASSERT_TRUE(rewriteList(registry(), 1, 1000));
    const auto key = registry().find(L"Software\\Tessel\\R21\\Profiles\\Default\\Dialogs\\Modrig\\History");
    for (DWORD index = 0; index < 1000; ++index)
    {
        const auto name = registry().valueName(key, index);
        ASSERT_EQ(name.code(), ERROR_SUCCESS);
        ASSERT_EQ(*name, std::to_wstring(index + 1) + L"History");
    }
    for (const DWORD index : {999u, 998u, 0u, 1u, 500u, 500u, 501u})
    {
        const auto name = registry().valueName(key, index);
        ASSERT_EQ(name.code(), ERROR_SUCCESS);
        EXPECT_EQ(*name, std::to_wstring(index + 1) + L"History");
    }
    EXPECT_EQ(registry().valueName(key, 1000).code(), ERROR_SUCCESS);
    EXPECT_EQ(registry().valueName(key, 1001).code(), ERROR_NO_MORE_ITEMS);
    EXPECT_EQ(registry().valueName(key, 0xFFFFFFFF).code(), ERROR_NO_MORE_ITEMS);
    EXPECT_EQ(registry().valueName(Registry::kNoKey, 0).code(), ERROR_NO_MORE_ITEMS);
}

TEST_F(RegistryStore, FindsNoKeyWhereOneWasRemovedInTheSameCommand)
{
    EXPECT_TRUE(registry().write(L"A\\B", L"name", L"data"));
    const auto key = registry().find(L"A\\B");
    ASSERT_NE(key, Registry::kNoKey);
    EXPECT_TRUE(registry().removeKey(registry().find(L"A")));
    ASSERT_EQ(registry().find(L"A\\B"), Registry::kNoKey);
    EXPECT_TRUE(registry().write(L"A\\B", L"name", L"again"));
    EXPECT_NE(registry().find(L"A\\B"), key);
    EXPECT_EQ(registry().read(L"A\\B", L"name"), L"again");
}

TEST_F(RegistryStore, FollowsTheSamePathFromEachKey)
{
    EXPECT_TRUE(registry().write(L"A\\C", L"name", L"in A"));
    EXPECT_TRUE(registry().write(L"B\\C", L"name", L"in B"));
    for (const wchar_t* above : {L"A", L"B"})
    {
        const auto key = registry().find(L"C", registry().find(above));
        EXPECT_EQ(*registry().readValue(key, L"name"), std::wstring(L"in ") + above);
    }
}

TEST_F(RegistryStore, ReadsWhatTheCommandWroteAheadOfItsReading)
{
    ASSERT_TRUE(rewriteList(registry(), 1, 10));
    const wchar_t* const path = L"Software\\Tessel\\R21\\Profiles\\Default\\Dialogs\\Modrig\\History";
    const auto key = registry().find(path);
    for (const wchar_t* name : {L"1History", L"2History", L"3History", L"4History"})
        ASSERT_TRUE(registry().readValue(key, name));
    EXPECT_TRUE(registry().writeValue(key, L"5History", L"new"));
    EXPECT_TRUE(registry().removeValue(key, L"6History"));
    EXPECT_EQ(*registry().readValue(key, L"5History"), L"new");
    EXPECT_FALSE(registry().readValue(key, L"6History"));
    EXPECT_TRUE(registry().readValue(key, L"7History"));
    EXPECT_TRUE(registry().endOfCommand());
    host.open();
    EXPECT_EQ(registry().read(path, L"5History"), L"new");
}

TEST_F(RegistryStore, SeesInTheNextCommandWhatAnotherSessionHasChangedInAList)
{
    ASSERT_TRUE(rewriteList(registry(), 1, 10));
    ASSERT_TRUE(registry().endOfCommand());
    const wchar_t* const path = L"Software\\Tessel\\R21\\Profiles\\Default\\Dialogs\\Modrig\\History";
    for (const wchar_t* name : {L"1History", L"2History", L"3History", L"4History"})
        ASSERT_TRUE(registry().read(path, name));
    Registry other(host.file());
    EXPECT_TRUE(other.write(path, L"5History", L"theirs"));
    EXPECT_TRUE(other.endOfCommand()) << "reading keeps nobody from writing";
    EXPECT_NE(registry().read(path, L"5History"), L"theirs") << "the list is read as it stood";
    EXPECT_TRUE(registry().endOfCommand());
    EXPECT_EQ(registry().read(path, L"5History"), L"theirs");
    EXPECT_TRUE(other.removeKey(other.find(path)));
    EXPECT_TRUE(other.endOfCommand());
    EXPECT_TRUE(registry().endOfCommand());
    EXPECT_EQ(registry().find(path), Registry::kNoKey);
}

TEST_F(RegistryStore, WalksTwoKeysAtTheSameTime)
{
    for (const wchar_t* name : {L"1", L"2", L"3"})
    {
        EXPECT_TRUE(registry().write(L"A", std::wstring(L"a") + name, L""));
        EXPECT_TRUE(registry().write(L"B", std::wstring(L"b") + name, L""));
    }
    std::vector<std::wstring> names;
    for (DWORD index = 0; index < 3; ++index)
        for (const wchar_t* path : {L"A", L"B"})
        {
            const auto name = registry().valueName(registry().find(path), index);
            ASSERT_EQ(name.code(), ERROR_SUCCESS);
            names.push_back(*name);
        }
    EXPECT_THAT(names, ElementsAre(L"a1", L"b1", L"a2", L"b2", L"a3", L"b3"));
}

TEST_F(RegistryStore, GivesANewRegistryItsFirstProfileOnly)
{
    const tessel::Profiles first(host.layered(), L"Product");
    EXPECT_EQ(registry().read(L"Product\\Profiles", L""), L"Default");
    EXPECT_TRUE(registry().write(L"Product\\Profiles", L"", L"Zweites Büro"));
    const tessel::Profiles second(host.layered(), L"Product");
    EXPECT_EQ(registry().read(L"Product\\Profiles", L""), L"Zweites Büro");
}

TEST_F(RegistryStore, EndsACommandThatWroteNothingWithoutAWord)
{
    EXPECT_TRUE(registry().endOfCommand());
    EXPECT_TRUE(registry().endOfCommand());
    EXPECT_THAT(host.output().text(), IsEmpty());
}

TEST_F(RegistryStore, IsInterruptedOnlyWhereMuchIsReadAndOnlyForThatCommand)
{
    ASSERT_TRUE(registry().write(L"A", L"name", L"1"));
    ASSERT_TRUE(registry().endOfCommand());
    registry().interrupt();
    EXPECT_EQ(registry().read(L"A", L"name"), L"1") << "nobody waits for so little";
    const Registry::Key key = registry().find(L"A");
    for (int i = 0; i < 11'000; ++i)
        ASSERT_TRUE(registry().writeValue(key, L"name", L"2"));
    registry().interrupt();
    EXPECT_FALSE(registry().writeValue(key, L"name", L"2"));
    const auto stopped = registry().endOfCommand();
    EXPECT_NE(
        stopped.sentence().find(L"could not be written: interrupted. What was stored before is unchanged."),
        std::wstring::npos);
    EXPECT_EQ(registry().read(L"A", L"name"), L"1");
    EXPECT_TRUE(registry().write(L"A", L"name", L"3")) << "the next command";
    EXPECT_TRUE(registry().endOfCommand());
    for (int i = 0; i < 11'000; ++i)
        ASSERT_TRUE(registry().read(L"A", L"name"));
    registry().interrupt();
    EXPECT_FALSE(registry().read(L"A", L"name"));
    EXPECT_FALSE(registry().endOfCommand());
    EXPECT_EQ(registry().read(L"A", L"name"), L"3");
    EXPECT_FALSE(registry().write(L"A", L"name", L"4")) << "who was to read it all may know less";
}
