#include "modrig/types/FileValidation.h"

#include "modrig/messages/MessageIds.h"
#include "tests/support/ModuleTest.h"

using namespace ModrigUtils;
using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
class FileValidation : public ModuleTest
{
protected:
    // The path as it stands after the search.
    std::wstring Found(const std::wstring& path)
    {
        CStdStr text(path);
        mAttributes = ValidateFileExists(text);
        return text.Text();
    }

    DWORD mAttributes = 0;
};

class UrlValidation : public ModuleTest
{
protected:
    static std::wstring Validated(const std::wstring& path)
    {
        CStdStr text(path);
        ValidateURLFile(text, nullptr);
        return text.Text();
    }
    static void Serve(const std::wstring& url, int status)
    {
        host().applicationServices.remotes[url] = {status, L"/cache/tool.lsp"};
    }
};
} // namespace

TEST_F(FileValidation, AcceptsEveryKindOfApplicationInAnyCase)
{
    for (const wchar_t* path : {L"/a/t.bundle", L"/a/t.ZMB", L"/a/t.lsp", L"/a/t.Mcp", L"/a/t.omp",
                                L"/a/t.rpk", L"/a/t.qbc", L"/a b/100%.x.lsp"})
        EXPECT_TRUE(IsValidFileForModrig(path));
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(FileValidation, RefusesAPathWithoutADotAndSaysSo)
{
    EXPECT_FALSE(IsValidFileForModrig(L"/a/tool"));
    EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kCannotLoadFile, L"/a/tool")));
}

TEST_F(FileValidation, RefusesAPathThatEndsWithItsDotAndSaysSo)
{
    EXPECT_FALSE(IsValidFileForModrig(L"/a/tool."));
    EXPECT_FALSE(IsValidFileForModrig(L"/a/tool.lsp."));
    EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kCannotLoadFile, L"/a/tool."),
                                     Message(ModrigMessages::kCannotLoadFile, L"/a/tool.lsp.")));
}

TEST_F(FileValidation, RefusesAnUnknownExtensionSilently)
{
    EXPECT_FALSE(IsValidFileForModrig(L"/a/tool.txt"));
    EXPECT_FALSE(IsValidFileForModrig(L"dir.old/tool"));
    EXPECT_FALSE(IsValidFileForModrig(L"/a.lsp/tool"));
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(FileValidation, LeavesThePathOfAFileThatExists)
{
    host().files.addFile(L"/x/tool.lsp", 0x21);
    EXPECT_EQ(L"/x/tool.lsp", Found(L"/x/tool.lsp"));
    EXPECT_EQ(0x21u, mAttributes);
    EXPECT_THAT(host().files.attributesAsked, ElementsAre(L"/x/tool.lsp"));
    EXPECT_THAT(host().files.searched, IsEmpty());
}

TEST_F(FileValidation, AcceptsAFolderAsItIs)
{
    host().files.addFolder(L"/x/tool.bundle");
    EXPECT_EQ(L"/x/tool.bundle", Found(L"/x/tool.bundle"));
    EXPECT_EQ(FILE_ATTRIBUTE_DIRECTORY, mAttributes);
}

TEST_F(FileValidation, FindsAMissingFileByItsNameInTheCurrentFolder)
{
    host().files.addFile(L"/current/tool.lsp", 0x21);
    EXPECT_EQ(L"/current/tool.lsp", Found(L"/x/y/tool.lsp"));
    EXPECT_EQ(0x21u, mAttributes);
    EXPECT_THAT(host().files.attributesAsked, ElementsAre(L"/x/y/tool.lsp", L"tool.lsp"));
    EXPECT_THAT(host().files.searched, IsEmpty());
}

TEST_F(FileValidation, FindsAMissingFileAlongTheSearchPath)
{
    host().files.searchFolders = {L"/search"};
    host().files.addFile(L"/search/tool.lsp", 0x21);
    EXPECT_EQ(L"/search/tool.lsp", Found(L"C:\\x\\tool.lsp"));
    EXPECT_EQ(0x21u, mAttributes);
    EXPECT_THAT(host().files.attributesAsked,
                ElementsAre(L"C:\\x\\tool.lsp", L"tool.lsp", L"/search/tool.lsp"));
}

TEST_F(FileValidation, TriesEveryKindInTableOrderForANameWithoutExtension)
{
    EXPECT_EQ(L"/x/tool", Found(L"/x/tool"));
    EXPECT_EQ(INVALID_FILE_ATTRIBUTES, mAttributes);
    EXPECT_EQ(0xFFFFFFFFu, mAttributes);
    EXPECT_THAT(host().files.attributesAsked,
                ElementsAre(L"/x/tool", L"tool.bundle", L"tool.zmb", L"tool.lsp", L"tool.mcp", L"tool.omp",
                            L"tool.rpk", L"tool.qbc"));
    EXPECT_THAT(host().files.searched, ElementsAre(L"tool.bundle", L"tool.zmb", L"tool.lsp", L"tool.mcp",
                                                   L"tool.omp", L"tool.rpk", L"tool.qbc"));
}

TEST_F(FileValidation, LooksThroughTheWholeCurrentFolderBeforeTheSearchPath)
{
    Found(L"tool");
    const auto entries = WithoutBookkeeping(host().journal.entries());
    const auto firstSearch =
        std::find_if(entries.begin(), entries.end(),
                     [](const std::wstring& entry) { return entry.starts_with(L"tsedFindFile"); });
    EXPECT_EQ(8, firstSearch - entries.begin());
    EXPECT_TRUE(std::none_of(firstSearch, entries.end(),
                             [](const std::wstring& entry)
                             { return entry.starts_with(L"GetFileAttributesW"); }));
}

TEST_F(FileValidation, FindsABundleBeforeALispFile)
{
    host().files.addFile(L"/current/tool.lsp");
    host().files.addFolder(L"/current/tool.bundle");
    EXPECT_EQ(L"/current/tool.bundle", Found(L"tool"));
}

TEST_F(FileValidation, FindsAnythingInTheCurrentFolderBeforeAnythingOnTheSearchPath)
{
    host().files.addFile(L"/current/tool.qbc");
    host().files.found[L"tool.bundle"] = L"/search/tool.bundle";
    EXPECT_EQ(L"/current/tool.qbc", Found(L"/x/tool"));
}

TEST_F(FileValidation, FindsInTableOrderAlongTheSearchPathToo)
{
    host().files.searchFolders = {L"/first", L"/second"};
    host().files.addFile(L"/first/tool.lsp");
    host().files.addFile(L"/second/tool.zmb");
    EXPECT_EQ(L"/second/tool.zmb", Found(L"tool"));
}

TEST_F(FileValidation, TakesADotAloneForNoExtension)
{
    host().files.addFile(L"/current/tool.lsp");
    EXPECT_EQ(L"/current/tool.lsp", Found(L"/x/tool."));
}

TEST_F(FileValidation, LooksForAnUnknownExtensionAsItIs)
{
    EXPECT_EQ(L"/x/tool.txt", Found(L"/x/tool.txt"));
    EXPECT_THAT(host().files.searched, ElementsAre(L"tool.txt"));
}

TEST_F(FileValidation, AnswersTheAttributesOfWhatTheSearchFound)
{
    host().files.found[L"tool.lsp"] = L"/gone/tool.lsp";
    EXPECT_EQ(L"/gone/tool.lsp", Found(L"/x/tool.lsp")) << "the search has the last word on the path";
    EXPECT_EQ(INVALID_FILE_ATTRIBUTES, mAttributes);
}

TEST_F(FileValidation, FindsNamesWithBlanksPerCentSignsAndLettersOfAnyScript)
{
    for (const wchar_t* name : {L"a b.lsp", L"100%s%n.lsp", L"tööl \"x\".lsp", L"чертёж.lsp"})
    {
        host().files.addFile(std::wstring(L"/current/") + name);
        EXPECT_EQ(std::wstring(L"/current/") + name, Found(std::wstring(L"/x/") + name));
    }
}

TEST_F(FileValidation, FindsNothingByAPathThatIsTooLongToBeTakenApart)
{
    const std::wstring path = LongPath(4000, L"tool.lsp");
    host().files.addFile(L"/current/tool.lsp");
    EXPECT_EQ(path, Found(path));
    EXPECT_EQ(INVALID_FILE_ATTRIBUTES, mAttributes);
    host().files.addFile(path);
    EXPECT_EQ(path, Found(path));
    EXPECT_EQ(FILE_ATTRIBUTE_NORMAL, mAttributes);
}

TEST_F(FileValidation, FitsTheLongestPathThatTheSearchCanFind)
{
    const std::wstring longest = LongPath(1023, L"tool.lsp");
    host().files.addFile(longest, 0x21);
    host().files.found[L"tool.lsp"] = longest;
    EXPECT_EQ(longest, Found(L"/x/tool.lsp"));
    EXPECT_EQ(0x21u, mAttributes);
    host().files.found[L"tool.lsp"] = LongPath(1024, L"tool.lsp");
    EXPECT_EQ(L"/x/tool.lsp", Found(L"/x/tool.lsp"));
    EXPECT_EQ(INVALID_FILE_ATTRIBUTES, mAttributes);
}

TEST_F(FileValidation, HasRoomFor1024CharactersOfTheUrlThatAFileIsACopyOf)
{
    static_cast<void>(IsTempInternetFile(L"/cache/tool.lsp"));
    EXPECT_THAT(host().internet.rooms, ElementsAre(1024u));
}

TEST_F(FileValidation, TakesNoOtherFileForOneThatIsTooLongToBeTakenApart)
{
    for (const wchar_t* extension : {L"bundle", L"zmb", L"lsp", L"mcp", L"omp", L"rpk", L"qbc"})
    {
        host().files.addFile(std::wstring(L"/current/.") + extension);
        host().files.found[std::wstring(L".") + extension] = std::wstring(L"/search/.") + extension;
    }
    for (const std::wstring& path : {L"/x/" + std::wstring(300, L'n') + L".lsp", LongPath(4000, L"tool.lsp")})
    {
        EXPECT_EQ(path, Found(path));
        EXPECT_EQ(INVALID_FILE_ATTRIBUTES, mAttributes);
    }
    EXPECT_THAT(host().files.searched, IsEmpty());
}

TEST_F(FileValidation, NamesAFileInACurrentFolderThatDoesNotFitByItsNameAfterASlash)
{
    host().files.currentFolder = L"/" + std::wstring(1023, L'c');
    host().files.addFile(L"tool.lsp");
    EXPECT_EQ(L"/tool.lsp", Found(L"/x/tool.lsp"));
}

TEST_F(FileValidation, FitsTheLongestCurrentFolder)
{
    host().files.currentFolder = L"/" + std::wstring(1022, L'c');
    host().files.addFile(host().files.currentFolder + L"/tool.lsp");
    EXPECT_EQ(host().files.currentFolder + L"/tool.lsp", Found(L"/x/tool.lsp"));
}

TEST_F(FileValidation, KnowsACopyFromTheInternet)
{
    host().internet.urlsOfLocalFiles[L"/cache/tool.lsp"] = L"http://example.test/" + std::wstring(3000, L'u');
    EXPECT_TRUE(IsTempInternetFile(L"/cache/tool.lsp"));
    EXPECT_FALSE(IsTempInternetFile(L"/apps/tool.lsp"));
    EXPECT_THAT(host().internet.asked, ElementsAre(L"/cache/tool.lsp", L"/apps/tool.lsp"));
}

TEST_F(FileValidation, TakesEveryFileForALocalOneInAHostWithoutInternet)
{
    host().internet.exists = false;
    EXPECT_FALSE(IsTempInternetFile(L"/cache/tool.lsp"));
}

TEST_F(UrlValidation, ReplacesAUrlByTheLocalCopy)
{
    for (const int status : {20000, 20001})
    {
        Serve(L"http://example.test/tool.lsp", status);
        EXPECT_EQ(L"/cache/tool.lsp", Validated(L"http://example.test/tool.lsp"));
    }
    EXPECT_THAT(host().applicationServices.fetches,
                testing::Each(RecordingApplicationServices::Fetch{L"http://example.test/tool.lsp", false}));
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(UrlValidation, ReportsAUrlThatCannotBeFetched)
{
    for (const int status : {TS_FETCH_FAILED, 19999, 0, -1})
    {
        host().output.boxes.clear();
        Serve(L"http://example.test/tool.lsp", status);
        EXPECT_EQ(L"http://example.test/tool.lsp", Validated(L"http://example.test/tool.lsp"));
        EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kUrlNotFetched, L"%s")))
            << "the text as it stands, without an argument";
    }
}

TEST_F(UrlValidation, LeavesTheUrlWithoutItsClosingSeparatorsAfterAFailure)
{
    EXPECT_EQ(L"http://example.test/tool", Validated(L"http://example.test/tool//\\\\"));
    EXPECT_THAT(host().applicationServices.askedForUrl, ElementsAre(L"http://example.test/tool"));
}

TEST_F(UrlValidation, StripsBackslashesFirstAndThenSlashes)
{
    Validated(L"http://example.test/a/\\/\\");
    EXPECT_THAT(host().applicationServices.askedForUrl, ElementsAre(L"http://example.test/a/\\"));
}

TEST_F(UrlValidation, PutsBackAPathThatIsNoUrl)
{
    for (const wchar_t* path : {L"/apps/folder//", L"C:\\apps\\", L"tool.lsp"})
        EXPECT_EQ(path, Validated(path));
    EXPECT_THAT(host().applicationServices.askedForUrl,
                ElementsAre(L"/apps/folder", L"C:\\apps", L"tool.lsp"));
    EXPECT_THAT(host().applicationServices.fetches, IsEmpty());
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(UrlValidation, ComesToAnEndWithAPathOfSeparatorsOnly)
{
    EXPECT_EQ(L"////", Validated(L"////"));
    const std::wstring slashes(3000, L'/');
    EXPECT_EQ(slashes, Validated(slashes));
    EXPECT_THAT(host().applicationServices.askedForUrl, ElementsAre(L"", std::wstring(3000 - 1026, L'/')));
}

TEST_F(UrlValidation, StripsAtMost1026OfEachSeparator)
{
    const std::wstring url = L"http://example.test/";
    Validated(url + std::wstring(1030, L'\\'));
    Validated(url + std::wstring(1025, L'/') + std::wstring(1026, L'\\'));
    EXPECT_THAT(host().applicationServices.askedForUrl,
                ElementsAre(url + std::wstring(4, L'\\'), L"http://example.test"));
}

TEST_F(UrlValidation, DoesNothingForAnEmptyPathOrWithoutTheHostsServices)
{
    EXPECT_EQ(L"", Validated(L""));
    EXPECT_THAT(host().applicationServices.askedForUrl, IsEmpty());
    host().applicationServices.exist = false;
    EXPECT_EQ(L"http://example.test/tool.lsp/", Validated(L"http://example.test/tool.lsp/"));
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(UrlValidation, FitsTheLongestPathOfALocalCopy)
{
    const std::wstring url = L"http://example.test/tool.lsp";
    host().applicationServices.remotes[url] = {TS_FROM_CACHE, LongPath(1023, L"tool.lsp")};
    EXPECT_EQ(LongPath(1023, L"tool.lsp"), Validated(url));
    host().applicationServices.remotes[url] = {TS_FROM_CACHE, LongPath(1024, L"tool.lsp")};
    EXPECT_EQ(url, Validated(url));
    EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kUrlNotFetched, L"%s")));
}
