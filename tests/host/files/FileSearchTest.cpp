#include "host/files/FileSearch.h"

#include <gtest/gtest.h>

#include <optional>

#include <tessel/tsed.h>

#include "host/registry/SystemVariables.h"
#include "host/text/Running.h"
#include "host/text/Unicode.h"
#include "tests/host/files/CurrentFolder.h"
#include "tests/support/TemporaryFolder.h"

namespace fs = std::filesystem;

namespace
{
constexpr std::size_t kPathRoom = 1024;

class FileSearch : public testing::Test
{
protected:
    FileSearch()
    {
        for (const char* name : {"current", "host", "first", "second", "größe 100%"})
            fs::create_directory(folder / name);
        current.emplace(folder / "current");
        setSearchPath((folder / "first").string() + ";" + (folder / "second").string());
    }

    void setSearchPath(const std::string& path)
    {
        EXPECT_EQ(variables.set(tessel::kSearchPath, tessel::toWide(path)).sentence(), L"");
    }
    std::string find(const char* name)
    {
        const auto found = files.find(name);
        return found ? found->string() : "nothing";
    }
    std::string in(const char* name) { return (folder / name).string(); }

    TemporaryFolder folder;
    tessel::SystemVariables variables{nullptr, L""};
    tessel::FileSearch files{folder / "host", variables};
    std::optional<tessel::Published<tessel::FileSearch>> published{files};
    std::optional<CurrentFolder> current;
};
} // namespace

TEST_F(FileSearch, LooksInTheCurrentFolderThenTheHostsThenAlongTheVariable)
{
    folder.write("second/tool.lsp", "");
    EXPECT_EQ(find("tool.lsp"), in("second/tool.lsp"));
    folder.write("first/tool.lsp", "");
    EXPECT_EQ(find("tool.lsp"), in("first/tool.lsp"));
    folder.write("host/tool.lsp", "");
    EXPECT_EQ(find("tool.lsp"), in("host/tool.lsp"));
    folder.write("current/tool.lsp", "");
    EXPECT_EQ(find("tool.lsp"), in("current/tool.lsp"));
    EXPECT_EQ(find("other.lsp"), "nothing");
}

TEST_F(FileSearch, OnlyChecksAFullPath)
{
    folder.write("first/tool.lsp", "");
    EXPECT_EQ(find(in("first/tool.lsp").c_str()), in("first/tool.lsp"));
    EXPECT_EQ(find(in("second/tool.lsp").c_str()), "nothing");
    EXPECT_EQ(find("/tool.lsp"), "nothing");
}

TEST_F(FileSearch, FindsBelowTheFoldersToo)
{
    folder.write("first/deep/er/tool.lsp", "");
    EXPECT_EQ(find("deep/er/tool.lsp"), in("first/deep/er/tool.lsp"));
    EXPECT_EQ(find("./deep/../deep/er/tool.lsp"), in("first/deep/er/tool.lsp"));
}

TEST_F(FileSearch, FindsBundlesWhichAreFolders)
{
    fs::create_directory(folder / "second" / "tool.bundle");
    EXPECT_EQ(find("tool.bundle"), in("second/tool.bundle"));
}

TEST_F(FileSearch, TakesFolderNamesOfEveryKind)
{
    folder.write("größe 100%/tööl \"1\".lsp", "");
    setSearchPath(in("größe 100%") + "/");
    EXPECT_EQ(find("tööl \"1\".lsp"), in("größe 100%/tööl \"1\".lsp"));
}

TEST_F(FileSearch, PassesOverFoldersThatAreEmptyNamesOrMissing)
{
    folder.write("second/tool.lsp", "");
    setSearchPath(";;" + in("missing") + ";;" + in("second") + ";");
    EXPECT_EQ(find("tool.lsp"), in("second/tool.lsp"));
    setSearchPath(";");
    EXPECT_EQ(find("tool.lsp"), "nothing");
    setSearchPath("");
    EXPECT_EQ(find("tool.lsp"), "nothing");
}

TEST_F(FileSearch, TakesARelativeFolderFromTheCurrentOne)
{
    folder.write("second/tool.lsp", "");
    setSearchPath("../second");
    EXPECT_EQ(find("tool.lsp"), in("second/tool.lsp"));
}

TEST_F(FileSearch, GoesOnWhenTheCurrentFolderIsGone)
{
    folder.write("first/tool.lsp", "");
    fs::remove(folder / "current");
    EXPECT_EQ(find("tool.lsp"), in("first/tool.lsp"));
    EXPECT_EQ(find("other.lsp"), "nothing");
}

TEST_F(FileSearch, FindsNothingBesideACurrentFolderThatIsGone)
{
    folder.write("second/tool.lsp", "");
    setSearchPath("../second");
    fs::remove(folder / "current");
    EXPECT_EQ(find("tool.lsp"), "nothing");
}

TEST_F(FileSearch, FindsNothingForWhatIsNoName)
{
    EXPECT_EQ(find(""), "nothing");
    EXPECT_EQ(find(std::string(5000, 'x').c_str()), "nothing");
}

TEST_F(FileSearch, GivesApplicationsThePathWholeOrNotAtAll)
{
    const std::wstring path = tessel::toWide(folder.write("größe 100%/tool.lsp", "").string());
    setSearchPath(in("größe 100%"));
    wchar_t found[kPathRoom] = L"untouched";
    EXPECT_EQ(tsedFindFile(L"tool.lsp", found, path.size()), TS_ERROR);
    EXPECT_STREQ(found, L"untouched");
    EXPECT_EQ(tsedFindFile(L"tool.lsp", found, path.size() + 1), TS_NORMAL);
    EXPECT_EQ(path, found);
}

TEST_F(FileSearch, AnswersApplicationsWithAnError)
{
    wchar_t found[kPathRoom] = L"untouched";
    EXPECT_EQ(tsedFindFile(L"other.lsp", found, kPathRoom), TS_ERROR);
    EXPECT_EQ(tsedFindFile(L"", found, kPathRoom), TS_ERROR);
    EXPECT_EQ(tsedFindFile(nullptr, found, kPathRoom), TS_ERROR);
    EXPECT_EQ(tsedFindFile(L"other.lsp", nullptr, kPathRoom), TS_ERROR);
    published.reset();
    EXPECT_EQ(tsedFindFile(L"other.lsp", found, kPathRoom), TS_ERROR);
    EXPECT_STREQ(found, L"untouched");
}
