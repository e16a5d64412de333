#include "modrig/loader/FileIntake.h"

#include "modrig/lists/Globals.h"
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
    EXPECT_THAT(boxes(), ElementsAre(Message(37, L"50")));
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
    EXPECT_THAT(lines(), ElementsAre(Message(10, L"new.lsp")));
}

TEST_F(TakingFiles, CountsAFileThatWasInTheStartupSuiteWithoutAddingItTwice)
{
    Fill(gStartupList, {L"/a/old.lsp"});
    AddToStartupSuite(Paths({L"/A/Old.lsp"}));
    EXPECT_THAT(::Texts(gStartupList), ElementsAre(L"/a/old.lsp"));
    EXPECT_THAT(lines(), ElementsAre(Message(10, L"Old.lsp")));
}

TEST_F(TakingFiles, CountsSeveralFilesAddedToTheStartupSuite)
{
    AddToStartupSuite(Paths({L"/a/one.lsp", L"/a/two.lsp"}));
    EXPECT_THAT(lines(), ElementsAre(Message(11, L"2")));
}

TEST_F(TakingFiles, KeepsTemporaryInternetFilesOutOfTheStartupSuite)
{
    host().internet.urlsOfLocalFiles[L"/tmp/net.lsp"] = L"http://example.org/net.lsp";
    AddToStartupSuite(Paths({L"/tmp/net.lsp", L"/a/tool.lsp"}));
    EXPECT_THAT(boxes(), ElementsAre(Message(41, L"/tmp/net.lsp")));
    EXPECT_THAT(::Texts(gStartupList), ElementsAre(L"/a/tool.lsp"));
    EXPECT_THAT(lines(), ElementsAre(Message(10, L"tool.lsp")));
}

TEST_F(TakingFiles, SaysNothingWhenNothingJoinedTheStartupSuite)
{
    host().internet.urlsOfLocalFiles[L"/tmp/net.lsp"] = L"http://example.org/net.lsp";
    AddToStartupSuite(Paths({L"/tmp/net.lsp"}));
    AddToStartupSuite({});
    EXPECT_THAT(lines(), IsEmpty());
}
