#include "modrig/lists/ListMembership.h"

#include "modrig/lists/Globals.h"
#include "tests/support/ModuleTest.h"

using namespace ModrigUtils;
using testing::ElementsAre;

namespace
{
class ListMembership : public ModuleTest
{
protected:
    static bool Found(const wchar_t* path, std::initializer_list<const wchar_t*> entries)
    {
        CStringList list;
        Fill(list, entries);
        return FoundinSpecificList(path, list);
    }
};
} // namespace

TEST_F(ListMembership, FindsNothingInAnEmptyList)
{
    EXPECT_FALSE(Found(L"/a/tool.omp", {}));
    EXPECT_FALSE(Found(L"", {}));
}

TEST_F(ListMembership, FindsTheSamePathInAnyCase)
{
    EXPECT_TRUE(Found(L"/A/Tööl.LSP", {L"/x/y.lsp", L"/a/TÖÖL.lsp"}));
    EXPECT_TRUE(Found(L"c:\\APPS\\tool.zmb", {L"C:\\apps\\Tool.ZMB"}));
}

TEST_F(ListMembership, TellsTheSameNameInAnotherFolderApart)
{
    EXPECT_FALSE(Found(L"/b/tool.lsp", {L"/a/tool.lsp"}));
    EXPECT_FALSE(Found(L"D:\\apps\\tool.lsp", {L"C:\\apps\\tool.lsp"}));
    EXPECT_FALSE(Found(L"/b/tool.zmb", {L"/a/tool.zmb"}));
    EXPECT_FALSE(Found(L"tool.lsp", {L"/a/tool.lsp"}));
}

TEST_F(ListMembership, TellsTheSameNameWithAnotherExtensionApart)
{
    EXPECT_FALSE(Found(L"/a/tool.qbc", {L"/a/tool.lsp"}));
    EXPECT_FALSE(Found(L"/a/tool", {L"/a/tool.lsp"}));
    EXPECT_FALSE(Found(L"/a/tool.zmb", {L"/b/tool.omp"}));
}

TEST_F(ListMembership, FindsAnObjectDatabaseModuleByItsNameInWhateverFolder)
{
    EXPECT_TRUE(Found(L"/b/TOOL.omp", {L"/a/tool.OMP"}));
    EXPECT_TRUE(Found(L"tool.omp", {L"C:\\apps\\tool.omp"}));
}

TEST_F(ListMembership, TellsBundlesInDifferentFoldersApart)
{
    EXPECT_FALSE(Found(L"/b/tool.bundle", {L"/a/tool.bundle"}));
    EXPECT_FALSE(Found(L"/b/tool.BUNDLE", {L"/a/tool.bundle"}));
    EXPECT_TRUE(Found(L"/A/TOOL.bundle", {L"/a/tool.Bundle"}));
}

TEST_F(ListMembership, FindsAMatchAfterOthersOfTheSameName)
{
    EXPECT_TRUE(Found(L"/c/tool.lsp", {L"/a/tool.lsp", L"/b/tool.lsp", L"/c/tool.lsp", L"/d/tool.lsp"}));
}

TEST_F(ListMembership, ComparesNamesWithBlanksQuotesAndPerCentSignsLetterByLetter)
{
    EXPECT_TRUE(Found(L"/a b/100%S \"X\".LSP", {L"/A B/100%s \"x\".lsp"}));
    EXPECT_FALSE(Found(L"/a b/100%d.lsp", {L"/a b/100%s.lsp"}));
    EXPECT_FALSE(Found(L"/a/tool.lsp ", {L"/a/tool.lsp"}));
}

TEST_F(ListMembership, TakesAPathThatIsTooLongToBeTakenApartForNothingButItself)
{
    const std::wstring one = LongPath(4000, L"one.lsp");
    CStringList list;
    list.AddTail(CStdStr(one));
    EXPECT_TRUE(FoundinSpecificList(CStdStr(one), list));
    EXPECT_TRUE(FoundinSpecificList(CStdStr(LongPath(4000, L"ONE.LSP")), list));
    for (const std::wstring& other : {LongPath(4000, L"two.lsp"), LongPath(4001, L"one.lsp"),
                                      std::wstring(L"/a/one.lsp"), std::wstring()})
        EXPECT_FALSE(FoundinSpecificList(CStdStr(other), list));
}

TEST_F(ListMembership, TakesNoPathThatIsTooLongForAnObjectDatabaseModuleOfAnotherFolder)
{
    const std::wstring path = L"/a/" + std::wstring(300, L'n') + L".omp";
    CStringList list;
    list.AddTail(CStdStr(path));
    EXPECT_TRUE(FoundinSpecificList(CStdStr(path), list));
    EXPECT_FALSE(FoundinSpecificList(CStdStr(L"/b/" + std::wstring(300, L'n') + L".omp"), list));
}

TEST_F(ListMembership, TakesNoEntryThatIsTooLongForAnEmptyPath)
{
    CStringList list;
    Fill(list, {L""});
    EXPECT_FALSE(FoundinSpecificList(CStdStr(LongPath(4000, L"one.lsp")), list));
    EXPECT_TRUE(FoundinSpecificList(L"", list));
}

TEST_F(ListMembership, AsksTheListThatItIsNamedAfter)
{
    Fill(gLoadedAppList, {L"/a/loaded.lsp"});
    Fill(gStartupList, {L"/a/startup.lsp"});
    Fill(gHistoryList, {L"/a/history.lsp"});
    EXPECT_TRUE(FoundinLoadedList(L"/A/LOADED.lsp"));
    EXPECT_FALSE(FoundinLoadedList(L"/a/startup.lsp"));
    EXPECT_TRUE(FoundinStartupList(L"/A/STARTUP.lsp"));
    EXPECT_FALSE(FoundinStartupList(L"/a/history.lsp"));
    EXPECT_TRUE(FoundinHistoryList(L"/A/HISTORY.lsp"));
    EXPECT_FALSE(FoundinHistoryList(L"/a/loaded.lsp"));
}

TEST_F(ListMembership, KnowsLispApplicationsAmongTheLoadedOnes)
{
    Fill(gLoadedAppList,
         {L"/a/t.lsp", L"/a/t.RPK", L"/a/t.qbc", L"/a/t.zmb", L"/a/t.mcp", L"/a/t.omp", L"/a/t"});
    EXPECT_TRUE(IsALispAppFoundinList(L"/a/T.LSP"));
    EXPECT_TRUE(IsALispAppFoundinList(L"/a/t.rpk"));
    EXPECT_TRUE(IsALispAppFoundinList(L"/a/t.QBC"));
    EXPECT_FALSE(IsALispAppFoundinList(L"/b/t.lsp"));
    for (const wchar_t* path : {L"/a/t.zmb", L"/a/t.mcp", L"/a/t.omp", L"/a/t"})
        EXPECT_FALSE(IsALispAppFoundinList(path)) << path;
}

TEST_F(ListMembership, RemovesTheFirstEntryThatEqualsTheWholePath)
{
    CStringList list;
    Fill(list, {L"/x.lsp", L"/A/TOOL.lsp", L"/a/tool.lsp"});
    RemoveInSpecificList(L"/a/Tool.LSP", list);
    EXPECT_THAT(Texts(list), ElementsAre(L"/x.lsp", L"/a/tool.lsp"));
}

TEST_F(ListMembership, RemovesAnObjectDatabaseModuleByItsWholePathOnly)
{
    CStringList list;
    Fill(list, {L"/a/tool.omp"});
    RemoveInSpecificList(L"/b/tool.omp", list);
    EXPECT_THAT(Texts(list), ElementsAre(L"/a/tool.omp"));
    RemoveInSpecificList(L"/A/TOOL.OMP", list);
    EXPECT_TRUE(list.IsEmpty());
}

TEST_F(ListMembership, RemovesByTheWholePathAlsoWhatIsTooLongToBeTakenApart)
{
    const std::wstring one = LongPath(4000, L"one.lsp");
    const std::wstring other = LongPath(4000, L"other.lsp");
    CStringList list;
    list.AddTail(CStdStr(one));
    list.AddTail(CStdStr(other));
    RemoveInSpecificList(CStdStr(other), list);
    EXPECT_THAT(Texts(list), ElementsAre(one));
}

TEST_F(ListMembership, ShowsTheListsThatTheDialogsAskFor)
{
    Fill(gLoadedAppList, {L"/a/loaded.lsp"});
    Fill(gStartupList, {L"/a/suite.lsp"});
    Fill(gHistoryList, {L"/a/history.lsp"});
    EXPECT_THAT(Texts(StartupSuiteFiles()), ElementsAre(L"/a/suite.lsp"));
    EXPECT_THAT(Texts(HistoryFiles()), ElementsAre(L"/a/history.lsp"));
}
