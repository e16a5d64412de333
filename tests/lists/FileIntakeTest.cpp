#include "modrig/lists/FileIntake.h"

#include <algorithm>

#include "modrig/lists/Globals.h"
#include "modrig/messages/MessageIds.h"
#include "tests/support/ModuleTest.h"

using namespace ModrigUtils;
using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
class TakingFiles : public ModuleTest
{
protected:
    static std::vector<CStdStr> Paths(std::initializer_list<const wchar_t*> paths)
    {
        return std::vector<CStdStr>(paths.begin(), paths.end());
    }
    static std::vector<std::wstring> Texts(const std::vector<CStdStr>& paths)
    {
        std::vector<std::wstring> texts;
        for (const CStdStr& path : paths)
            texts.push_back(path.Text());
        return texts;
    }
    // Adds the files to the Suite and to a table that shows it, and says how many joined.
    std::size_t AddToShown(const std::vector<CStdStr>& paths)
    {
        const auto hasRow = [&](std::size_t index)
        {
            return std::find(mRows.begin(), mRows.end(), paths[index].Text()) != mRows.end();
        };
        const auto addRow = [&](std::size_t index)
        {
            mRows.push_back(paths[index].Text());
            mEntriesBefore.push_back(gStartupList.GetCount());
        };
        return AddToShownStartupSuite(paths, {hasRow, addRow});
    }

    std::vector<std::wstring> mRows;
    // What the Suite held each time that a row came.
    std::vector<std::size_t> mEntriesBefore;
};
} // namespace

TEST_F(TakingFiles, AllowsFiftyFilesAtOnce)
{
    EXPECT_FALSE(RefuseTooManyFiles(50));
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(TakingFiles, RefusesFiftyOneFilesAndNamesTheLimit)
{
    EXPECT_TRUE(RefuseTooManyFiles(51));
    EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kTooManyFiles, L"50")));
}

TEST_F(TakingFiles, KeepsNoneOfTooManyFiles)
{
    host().files.addFile(L"/a/one.lsp");
    const std::vector<CStdStr> paths(51, CStdStr(L"/a/one.lsp"));
    EXPECT_THAT(AcceptedFiles(paths), IsEmpty());
    EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kTooManyFiles, L"50")));
    EXPECT_THAT(FilesNewToStartupSuite(paths), IsEmpty());
    EXPECT_EQ(2u, boxes().size());
    EXPECT_EQ(50u, AcceptedFiles(std::vector<CStdStr>(50, CStdStr(L"/a/one.lsp"))).size());
}

TEST_F(TakingFiles, KeepsApplicationsThatExistInTheirOrder)
{
    host().files.addFile(L"/a/two.zmb");
    host().files.addFile(L"/a/one.lsp");
    host().files.addFile(L"/a/text.txt");
    EXPECT_THAT(
        Texts(AcceptedFiles(Paths({L"/a/two.zmb", L"/a/text.txt", L"/a/missing.lsp", L"/a/one.lsp"}))),
        ElementsAre(L"/a/two.zmb", L"/a/one.lsp"));
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(TakingFiles, TakesAFileByThePathItWasFoundAt)
{
    host().files.addFile(L"/current/tool.lsp");
    EXPECT_THAT(Texts(AcceptedFiles(Paths({L"/gone/tool.lsp"}))), ElementsAre(L"/current/tool.lsp"));
}

TEST_F(TakingFiles, SkipsFilesOfTheStartupSuiteByThePathTheyWereFoundAt)
{
    host().files.addFile(L"/current/tool.lsp");
    host().files.addFile(L"/a/new.lsp");
    Fill(gStartupList, {L"/CURRENT/TOOL.lsp"});
    EXPECT_THAT(Texts(FilesNewToStartupSuite(Paths({L"/gone/tool.lsp", L"/a/new.lsp"}))),
                ElementsAre(L"/a/new.lsp"));
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(TakingFiles, AddsToTheEndOfTheStartupSuiteAndNamesTheOnlyFile)
{
    Fill(gStartupList, {L"/a/old.lsp"});
    AddToStartupSuite(Paths({L"/a/new.lsp"}));
    EXPECT_THAT(::Texts(gStartupList), ElementsAre(L"/a/old.lsp", L"/a/new.lsp"));
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kOneAddedToStartupSuite, L"new.lsp")));
}

TEST_F(TakingFiles, CountsAFileThatWasInTheStartupSuiteWithoutAddingItTwice)
{
    Fill(gStartupList, {L"/a/old.lsp"});
    AddToStartupSuite(Paths({L"/A/Old.lsp"}));
    EXPECT_THAT(::Texts(gStartupList), ElementsAre(L"/a/old.lsp"));
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kOneAddedToStartupSuite, L"Old.lsp")));
}

TEST_F(TakingFiles, CountsSeveralFilesAddedToTheStartupSuite)
{
    AddToStartupSuite(Paths({L"/a/one.lsp", L"/a/two.lsp"}));
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kManyAddedToStartupSuite, L"2")));
}

TEST_F(TakingFiles, KeepsTemporaryInternetFilesOutOfTheStartupSuite)
{
    host().internet.urlsOfLocalFiles[L"/tmp/net.lsp"] = L"http://example.org/net.lsp";
    AddToStartupSuite(Paths({L"/tmp/net.lsp", L"/a/tool.lsp"}));
    EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kTemporaryInternetFile, L"/tmp/net.lsp")));
    EXPECT_THAT(::Texts(gStartupList), ElementsAre(L"/a/tool.lsp"));
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kOneAddedToStartupSuite, L"tool.lsp")));
}

TEST_F(TakingFiles, SaysNothingWhenNothingJoinedTheStartupSuite)
{
    host().internet.urlsOfLocalFiles[L"/tmp/net.lsp"] = L"http://example.org/net.lsp";
    AddToStartupSuite(Paths({L"/tmp/net.lsp"}));
    AddToStartupSuite({});
    EXPECT_THAT(lines(), IsEmpty());
}

TEST_F(TakingFiles, AddsARowBeforeEachEntryOfTheShownStartupSuiteAndSaysNothing)
{
    Fill(gStartupList, {L"/a/old.lsp"});
    EXPECT_EQ(2u, AddToShown(Paths({L"/a/one.lsp", L"/a/two.lsp"})));
    EXPECT_THAT(::Texts(gStartupList), ElementsAre(L"/a/old.lsp", L"/a/one.lsp", L"/a/two.lsp"));
    EXPECT_THAT(mRows, ElementsAre(L"/a/one.lsp", L"/a/two.lsp"));
    EXPECT_THAT(mEntriesBefore, ElementsAre(1u, 2u));
    EXPECT_THAT(lines(), IsEmpty());
}

TEST_F(TakingFiles, AddsNothingToTheStartupSuiteThatItsTableShowsAlready)
{
    mRows = {L"/a/shown.lsp"};
    EXPECT_EQ(1u, AddToShown(Paths({L"/a/shown.lsp", L"/a/new.lsp", L"/a/new.lsp"})));
    EXPECT_THAT(::Texts(gStartupList), ElementsAre(L"/a/new.lsp"));
}

TEST_F(TakingFiles, KeepsTemporaryInternetFilesOutOfTheShownStartupSuite)
{
    host().internet.urlsOfLocalFiles[L"/tmp/net.lsp"] = L"http://example.org/net.lsp";
    EXPECT_EQ(1u, AddToShown(Paths({L"/tmp/net.lsp", L"/a/tool.lsp"})));
    EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kTemporaryInternetFile, L"/tmp/net.lsp")));
    EXPECT_THAT(::Texts(gStartupList), ElementsAre(L"/a/tool.lsp"));
    EXPECT_THAT(mRows, ElementsAre(L"/a/tool.lsp"));
}

TEST_F(TakingFiles, AsksNothingAboutAFileThatTheTableOfTheStartupSuiteShows)
{
    host().internet.urlsOfLocalFiles[L"/tmp/net.lsp"] = L"http://example.org/net.lsp";
    mRows = {L"/tmp/net.lsp"};
    EXPECT_EQ(0u, AddToShown(Paths({L"/tmp/net.lsp"})));
    EXPECT_THAT(boxes(), IsEmpty());
}
