#include "tests/dialogs/support/DialogTest.h"

#include <filesystem>

#import "modrig/dialogs/ModrigArrayController.h"

#include "modrig/dialogs/TableRows.h"

using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
// Paths of every kind in one folder, and what the toolkit makes of each.
class ResolvedLinks : public DialogTest
{
protected:
    void SetUp() override
    {
        DialogTest::SetUp();
        for (const char* name : {"tool.lsp", "real/tool.lsp", "real/d\u00E9j\u00E0/tool.lsp",
                                 "r\351al/tool.lsp", "real/s\u00E9parateur.lsp", "real/odd\xFF.lsp"})
            file(name);
        std::filesystem::create_directory(mFolder / "links");
        link("links/folder", "real");
        link("links/accents", "real/d\u00E9j\u00E0");
        link("links/bytes", "r\351al");
        link("links/file.lsp", "tool.lsp");
        link("real/link.lsp", "tool.lsp");
        link("links/nothing.lsp", "gone.lsp");
        link("links/gone", "gone");
        link("links/round", "links/round");
    }

    void link(const std::string& name, const std::string& target)
    {
        std::filesystem::create_symlink(mFolder / target, mFolder / name);
    }

    std::wstring in(const std::wstring& rest) { return mFolder.path().wstring() + rest; }

    // In one resolver, which remembers; all of them in both orders; expected and not.
    void expectTheToolkitsAnswers(const std::vector<std::wstring>& paths)
    {
        std::vector<std::wstring> all(paths);
        all.insert(all.end(), paths.rbegin(), paths.rend());
        for (const std::size_t times : {0, 1, 100})
        {
            const auto links = ModrigPlatform::MakeLinkResolver();
            for (std::size_t time = 0; time < times; ++time)
                for (const std::wstring& path : paths)
                    links->Expect(CStdStr(path));
            for (const std::wstring& path : all)
                EXPECT_EQ(wide([text(path) stringByResolvingSymlinksInPath]),
                          links->Resolve(CStdStr(path)).Text());
        }
    }

    static std::wstring resolved(const std::wstring& path)
    {
        return ModrigPlatform::MakeLinkResolver()->Resolve(CStdStr(path)).Text();
    }
};

class JoiningRows : public DialogTest
{
protected:
    void SetUp() override
    {
        DialogTest::SetUp();
        mTable = [[[ModrigArrayController alloc] initWithContent:[NSMutableArray array]] autorelease];
        [mTable setSelectionIndexes:[NSIndexSet indexSet]]; // as one that comes from a window file
    }

    void add(const std::vector<CStdStr>& paths) { ModrigUtils::AddRows(mTable, paths); }

    ModrigArrayController* mTable = nil;
};
} // namespace

TEST_F(ResolvedLinks, LeaveAPathAsItIsThatHasNone)
{
    expectTheToolkitsAnswers({in(L"/tool.lsp"), in(L"/real/tool.lsp"), in(L"/real"), L"/"});
}

TEST_F(ResolvedLinks, AreFollowedInTheFolderAndInTheFile)
{
    expectTheToolkitsAnswers({in(L"/links/folder/tool.lsp"), in(L"/links/folder/link.lsp"),
                              in(L"/links/file.lsp"), in(L"/links/folder"), in(L"/real/link.lsp")});
    EXPECT_EQ(in(L"/real/tool.lsp"), resolved(in(L"/links/folder/tool.lsp")));
    EXPECT_EQ(in(L"/tool.lsp"), resolved(in(L"/links/folder/link.lsp")));
}

TEST_F(ResolvedLinks, LeaveAPathAsItIsThatLeadsNowhere)
{
    expectTheToolkitsAnswers({in(L"/gone.lsp"), in(L"/gone/tool.lsp"), in(L"/links/nothing.lsp"),
                              in(L"/links/gone/tool.lsp"), in(L"/links/folder/gone.lsp"), in(L"/links/round"),
                              in(L"/links/round/tool.lsp"), in(L"/tool.lsp/tool.lsp"),
                              in(L"/" + std::wstring(300, L'x') + L"/tool.lsp"),
                              in(L"/real/" + std::wstring(300, L'x'))});
}

TEST_F(ResolvedLinks, AreFollowedInPathsThatAreWrittenInOtherWays)
{
    expectTheToolkitsAnswers({in(L"//real//tool.lsp"), in(L"/real/./tool.lsp"), in(L"/links/../tool.lsp"),
                              in(L"/links/folder/../tool.lsp"), in(L"/real/"), in(L"/real/."),
                              in(L"/links/folder/.."), in(L"/links/folder/"), in(L"/links/folder//"),
                              in(L"//links/folder//tool.lsp"), L"/etc", L"//etc", L"/..", L"/gone.lsp"});
}

TEST_F(ResolvedLinks, AreFollowedFromWhereTheProgramIs)
{
    const auto before = std::filesystem::current_path();
    std::filesystem::current_path(mFolder.path());
    expectTheToolkitsAnswers({L"tool.lsp", L"links/folder/tool.lsp", L"gone.lsp", L"", L".", L"~", L"~/x"});
    std::filesystem::current_path(before);
}

TEST_F(ResolvedLinks, AreFollowedWhateverTheNamesAre)
{
    expectTheToolkitsAnswers({in(L"/real/d\u00E9j\u00E0/tool.lsp"), in(L"/links/accents/tool.lsp"),
                              in(L"/real/s\u00E9parateur.lsp"), in(L"/links/folder/s\u00E9parateur.lsp"),
                              in(L"/real/odd\U0010FEFF.lsp"), in(L"/links/folder/odd\U0010FEFF.lsp"),
                              in(L"/r\U0010FEE9al/tool.lsp"), in(L"/links/bytes/tool.lsp")});
    EXPECT_EQ(in(L"/r\U0010FEE9al/tool.lsp"), resolved(in(L"/links/bytes/tool.lsp")));
}

TEST_F(JoiningRows, AreOneForEachFile)
{
    file("real.lsp");
    std::filesystem::create_directory(mFolder / "links");
    std::filesystem::create_symlink(mFolder / "real.lsp", mFolder / "links/link.lsp");
    std::filesystem::create_symlink(mFolder.path(), mFolder / "links/folder");
    add({CStdStr(file("links/link.lsp")), CStdStr(file("real.lsp")), CStdStr(file("links/folder/real.lsp"))});
    EXPECT_THAT(rowsOf(mTable), ElementsAre(file("real.lsp")));
}

TEST_F(JoiningRows, AreMadeFromTheResolvedPath)
{
    std::filesystem::create_symlink(mFolder / "real.zmb", mFolder / "link.zmb");
    host().linker.setLocked(file("real.zmb"));
    add({CStdStr(file("link.zmb"))});
    ModrigFilePath* row = [[mTable arrangedObjects] objectAtIndex:0];
    EXPECT_EQ(L"real.zmb", wide([row fileName]));
    EXPECT_EQ(file("real.zmb"), [row path].Text());
    EXPECT_FALSE([row unloadable]);
}

TEST_F(JoiningRows, KeepTheirPathsWhateverTheCharacters)
{
    for (const wchar_t* name : {L"tool.lsp", L"\u00FC \u4E2D \U0001F600.lsp", L"odd\U0010FEFF.lsp"})
    {
        const std::wstring path = std::wstring(L"/none/") + name;
        add({CStdStr(path)});
        ModrigFilePath* row = [[mTable arrangedObjects] lastObject];
        ModrigFilePath* twin = [[[ModrigFilePath alloc] initWithFilePathName:text(path)] autorelease];
        EXPECT_EQ(path, [row path].Text());
        EXPECT_EQ([twin hash], [row hash]);
        EXPECT_TRUE([twin isEqual:row]);
        EXPECT_EQ(path, wide([row filePathName]));
        EXPECT_EQ(name, wide([row fileName]));
        EXPECT_EQ(L"/none", wide([row filePath]));
    }
}

TEST_F(JoiningRows, StandAfterThoseThatAreThereInTheirOrder)
{
    add({CStdStr(L"/none/b.lsp")});
    add({CStdStr(L"/none/c.lsp"), CStdStr(L"/NONE/B.LSP"), CStdStr(L"/none/a.lsp"), CStdStr(L"/none/C.lsp")});
    EXPECT_THAT(rowsOf(mTable), ElementsAre(L"/none/b.lsp", L"/none/c.lsp", L"/none/a.lsp"));
}

TEST_F(JoiningRows, ComeSelectedUnlessTheTableIsFilled)
{
    const std::vector<CStdStr> paths = {CStdStr(L"/none/a.lsp"), CStdStr(L"/none/b.lsp")};
    ModrigUtils::FillTable(mTable, paths);
    EXPECT_THAT(selectionOf(mTable), IsEmpty());
    add({CStdStr(L"/none/c.lsp"), CStdStr(L"/none/d.lsp")});
    EXPECT_THAT(selectionOf(mTable), ElementsAre(L"/none/c.lsp", L"/none/d.lsp"));
}

TEST_F(JoiningRows, LeaveSelectedWhatIs)
{
    const std::vector<CStdStr> paths = {CStdStr(L"/none/a.lsp"), CStdStr(L"/none/b.lsp")};
    ModrigUtils::FillTable(mTable, paths);
    [mTable setSelectionIndexes:[NSIndexSet indexSetWithIndex:1]];
    [mTable setSelectsInsertedObjects:NO];
    add({CStdStr(L"/none/c.lsp")});
    EXPECT_THAT(selectionOf(mTable), ElementsAre(L"/none/b.lsp"));
}

TEST_F(JoiningRows, ChangeNothingWhereNoneIsNew)
{
    add({CStdStr(L"/none/a.lsp"), CStdStr(L"/none/b.lsp")});
    [mTable setSelectionIndexes:[NSIndexSet indexSetWithIndex:0]];
    add({CStdStr(L"/none/B.lsp")});
    EXPECT_THAT(selectionOf(mTable), ElementsAre(L"/none/a.lsp"));
}

TEST_F(JoiningRows, AreMadeForAFileWithoutADotToo)
{
    add({CStdStr(L"/none/tool")});
    EXPECT_THAT(rowsOf(mTable), ElementsAre(L"/none/tool"));
    EXPECT_EQ(1u, boxes().size());
}
