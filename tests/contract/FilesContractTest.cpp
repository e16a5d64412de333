#include <tessel/tsed.h>
#include <wincompat/winfile.h>

#include <cerrno>
#include <ostream>

#include "tests/contract/ContractTest.h"

namespace
{
class FilesContract : public ContractTest
{
protected:
    static std::wstring currentFolder()
    {
        wchar_t folder[kPathSize] = {};
        const DWORD length = GetCurrentDirectory(kPathSize, folder);
        EXPECT_EQ(length, std::wcslen(folder));
        return folder;
    }

    // Empty when it is not found.
    static std::wstring find(const std::wstring& name)
    {
        wchar_t found[kPathSize] = L"untouched";
        return tsedFindFile(name.c_str(), found, kPathSize) == TS_NORMAL ? found : L"";
    }

    // Empty when nothing is meant.
    static std::wstring meant(const std::wstring& typed)
    {
        wchar_t path[kPathSize] = L"untouched";
        return tsedTypedPath(typed.c_str(), path, kPathSize) == TS_NORMAL ? path : L"";
    }
};

TEST_F(FilesContract, TellsFilesFromFolders)
{
    EXPECT_EQ(GetFileAttributesW(host->makeFile(L"file.lsp").c_str()), FILE_ATTRIBUTE_NORMAL);
    EXPECT_EQ(GetFileAttributesW(host->makeFolder(L"folder").c_str()), FILE_ATTRIBUTE_DIRECTORY);
    EXPECT_EQ(GetFileAttributesW(host->makeReadOnlyFile(L"kept.lsp").c_str()), FILE_ATTRIBUTE_READONLY);
    EXPECT_EQ(GetFileAttributesW(host->makePipe(L"pipe.lsp").c_str()), FILE_ATTRIBUTE_DEVICE);
}

TEST_F(FilesContract, HasNoAttributesForWhatIsMissing)
{
    const std::wstring folder = host->makeFolder(L"folder");
    EXPECT_EQ(GetFileAttributesW((folder + L"/none.lsp").c_str()), INVALID_FILE_ATTRIBUTES);
    EXPECT_EQ(GetFileAttributesW(L""), INVALID_FILE_ATTRIBUTES);
}

TEST_F(FilesContract, FindsFilesWithUnusualNames)
{
    for (const wchar_t* name : {L"a b.lsp", L"100%s.lsp", L"\u00FC\u4E2D\U0001F600.lsp", L"it's \"it\".lsp"})
        EXPECT_EQ(GetFileAttributesW(host->makeFile(name).c_str()), FILE_ATTRIBUTE_NORMAL);
}

TEST_F(FilesContract, TakesARelativePathFromTheCurrentFolder)
{
    host->enterFolder(host->makeFolder(L"folder"));
    host->makeFile(L"folder/tool.lsp");
    EXPECT_EQ(GetFileAttributesW(L"tool.lsp"), FILE_ATTRIBUTE_NORMAL);
    host->enterFolder(host->makeFolder(L"other"));
    EXPECT_EQ(GetFileAttributesW(L"tool.lsp"), INVALID_FILE_ATTRIBUTES);
}

TEST_F(FilesContract, NamesTheCurrentFolder)
{
    const std::wstring folder = host->makeFolder(L"f\u00F6lder");
    host->enterFolder(folder);
    EXPECT_EQ(currentFolder(), folder);
}

TEST_F(FilesContract, SaysHowMuchRoomTheCurrentFolderNeeds)
{
    const std::wstring folder = host->makeFolder(L"folder");
    host->enterFolder(folder);
    const DWORD needed = static_cast<DWORD>(folder.size() + 1);
    std::vector<wchar_t> buffer(needed);
    EXPECT_EQ(GetCurrentDirectory(needed - 1, buffer.data()), needed);
    EXPECT_EQ(GetCurrentDirectory(0, nullptr), needed);
    EXPECT_EQ(GetCurrentDirectory(needed, buffer.data()), needed - 1);
    EXPECT_EQ(std::wstring(buffer.data()), folder);
}

TEST_F(FilesContract, LooksInTheCurrentFolderBeforeTheSearchPath)
{
    const std::wstring current = host->makeFolder(L"current");
    const std::wstring first = host->makeFolder(L"first");
    const std::wstring second = host->makeFolder(L"second");
    host->enterFolder(current);
    host->searchIn({first, second});
    EXPECT_EQ(find(L"tool.lsp"), L"");
    const std::wstring inSecond = host->makeFile(L"second/tool.lsp");
    EXPECT_EQ(find(L"tool.lsp"), inSecond);
    const std::wstring inFirst = host->makeFile(L"first/tool.lsp");
    EXPECT_EQ(find(L"tool.lsp"), inFirst);
    const std::wstring inCurrent = host->makeFile(L"current/tool.lsp");
    EXPECT_EQ(find(L"tool.lsp"), inCurrent);
}

TEST_F(FilesContract, OnlyChecksAFullPath)
{
    const std::wstring folder = host->makeFolder(L"folder");
    host->searchIn({folder});
    host->makeFile(L"folder/tool.lsp");
    const std::wstring file = host->makeFile(L"elsewhere.lsp");
    EXPECT_EQ(find(file), file);
    EXPECT_EQ(find(host->makeFolder(L"other") + L"/tool.lsp"), L"");
}

TEST_F(FilesContract, DoesNotFindWhatDoesNotFit)
{
    const std::wstring file = host->makeFile(L"tool.lsp");
    std::vector<wchar_t> buffer(file.size() + 1);
    EXPECT_EQ(tsedFindFile(file.c_str(), buffer.data(), file.size()), TS_ERROR);
    EXPECT_EQ(tsedFindFile(file.c_str(), buffer.data(), file.size() + 1), TS_NORMAL);
    EXPECT_EQ(std::wstring(buffer.data()), file);
}

TEST_F(FilesContract, HasOnePathForWhatIsTypedInManyWays)
{
    const std::wstring folder = host->makeFolder(L"folder");
    host->enterFolder(folder);
    for (const wchar_t* typed : {L"tool.lsp", L"./tool.lsp", L"a/../tool.lsp", L".//tool.lsp", L"tool.lsp/"})
        EXPECT_EQ(meant(typed), folder + L"/tool.lsp") << typed;
    for (const wchar_t* rest : {L"/tool.lsp", L"//tool.lsp", L"/./tool.lsp", L"/b/../tool.lsp"})
        EXPECT_EQ(meant(folder + rest), folder + L"/tool.lsp") << rest;
    EXPECT_EQ(meant(L"/.."), L"/");
    EXPECT_EQ(meant(L""), L"");
}

TEST_F(FilesContract, GivesNoPartOfAPathThatIsTyped)
{
    std::vector<wchar_t> buffer(10);
    EXPECT_EQ(tsedTypedPath(L"/tool.lsp", buffer.data(), 9), TS_ERROR);
    EXPECT_EQ(tsedTypedPath(L"/tool.lsp", buffer.data(), 10), TS_NORMAL);
    EXPECT_EQ(std::wstring(buffer.data()), L"/tool.lsp");
}

struct Split
{
    const wchar_t* path;
    const wchar_t* drive;
    const wchar_t* folder;
    const wchar_t* name;
    const wchar_t* extension;
};

// Names the case in the list of tests.
void PrintTo(const Split& split, std::ostream* stream)
{
    *stream << testing::PrintToString(std::wstring(split.path));
}

class SplitPathContract : public ContractTest, public testing::WithParamInterface<Split>
{
};

TEST_P(SplitPathContract, TakesThePathApart)
{
    wchar_t drive[3];
    wchar_t folder[kPathSize];
    wchar_t name[256];
    wchar_t extension[256];
    EXPECT_EQ(_wsplitpath_s(GetParam().path, drive, 3, folder, kPathSize, name, 256, extension, 256), 0);
    EXPECT_STREQ(drive, GetParam().drive);
    EXPECT_STREQ(folder, GetParam().folder);
    EXPECT_STREQ(name, GetParam().name);
    EXPECT_STREQ(extension, GetParam().extension);
}

INSTANTIATE_TEST_SUITE_P(
    Paths, SplitPathContract,
    testing::Values(Split{L"/a/b/tool.lsp", L"", L"/a/b/", L"tool", L".lsp"},
                    Split{L"C:\\a\\tool.lsp", L"C:", L"\\a\\", L"tool", L".lsp"},
                    Split{L"C:tool", L"C:", L"", L"tool", L""},
                    Split{L"/a\\b/tool", L"", L"/a\\b/", L"tool", L""},
                    Split{L"\\\\server\\share\\tool.zmb", L"", L"\\\\server\\share\\", L"tool", L".zmb"},
                    Split{L"/dir.old/tool", L"", L"/dir.old/", L"tool", L""},
                    Split{L"tool.tar.gz", L"", L"", L"tool.tar", L".gz"},
                    Split{L"tool.", L"", L"", L"tool", L"."},
                    Split{L"/a/.hidden", L"", L"/a/", L"", L".hidden"},
                    Split{L"/a/b/", L"", L"/a/b/", L"", L""}, Split{L"", L"", L"", L"", L""}));

using SplitPathSizesContract = ContractTest;

TEST_F(SplitPathSizesContract, EmptiesAllFourWhenOneDoesNotFit)
{
    wchar_t drive[3] = L"x";
    wchar_t folder[8] = L"x";
    wchar_t name[5] = L"x";
    wchar_t extension[5] = L"x";
    EXPECT_EQ(_wsplitpath_s(L"C:/a/tool.lsp", drive, 3, folder, 8, name, 4, extension, 5), ERANGE);
    EXPECT_STREQ(drive, L"");
    EXPECT_STREQ(folder, L"");
    EXPECT_STREQ(name, L"");
    EXPECT_STREQ(extension, L"");
    EXPECT_EQ(_wsplitpath_s(L"C:/a/tool.lsp", drive, 3, folder, 8, name, 5, extension, 5), 0);
    EXPECT_STREQ(name, L"tool");
}

TEST_F(SplitPathSizesContract, PassesOverPartsThatNobodyWants)
{
    wchar_t name[5] = L"x";
    EXPECT_EQ(_wsplitpath_s(L"C:/a/tool.lsp", nullptr, 0, nullptr, 0, name, 5, nullptr, 0), 0);
    EXPECT_STREQ(name, L"tool");
}

TEST_F(SplitPathSizesContract, RefusesWhatMakesNoSense)
{
    wchar_t name[5] = L"x";
    EXPECT_EQ(_wsplitpath_s(nullptr, nullptr, 0, nullptr, 0, name, 5, nullptr, 0), EINVAL);
    EXPECT_EQ(_wsplitpath_s(L"/a", nullptr, 1, nullptr, 0, name, 5, nullptr, 0), EINVAL);
    EXPECT_EQ(_wsplitpath_s(L"/a", nullptr, 0, nullptr, 0, name, 0, nullptr, 0), EINVAL);
}
} // namespace
