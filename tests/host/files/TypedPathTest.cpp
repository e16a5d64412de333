#include "host/files/TypedPath.h"

#include <gtest/gtest.h>

#include <tessel/tsed.h>

#include "host/text/Unicode.h"
#include "tests/host/files/CurrentFolder.h"
#include "tests/support/EnvironmentVariable.h"
#include "tests/support/TemporaryFolder.h"

namespace fs = std::filesystem;

namespace
{
class TypedPath : public testing::Test
{
protected:
    TypedPath()
    {
        for (const char* name : {"home/deep/folder", "current"})
            fs::create_directories(folder / name);
        current.emplace(folder / "current");
    }

    std::string in(const std::string& name) const { return (folder.path() / name).string(); }
    static std::string whole(const std::string& typed)
    {
        const auto path = tessel::wholePath(typed);
        return path ? path->string() : "none";
    }

    TemporaryFolder folder;
    EnvironmentVariable home{"HOME", in("home")};
    std::optional<CurrentFolder> current;
};
} // namespace

TEST_F(TypedPath, IsOneForOneFile)
{
    for (const char* typed : {"a.lsp", "./a.lsp", "x/../a.lsp", "..//current/a.lsp", "a.lsp/", "a.lsp/."})
        EXPECT_EQ(whole(typed), in("current/a.lsp")) << typed;
    EXPECT_EQ(whole("/../..//a.lsp"), "/a.lsp");
    EXPECT_EQ(whole("/"), "/");
    EXPECT_EQ(whole(".."), folder.path().string());
}

TEST_F(TypedPath, BeginsInTheHomeFolderAfterATilde)
{
    EXPECT_EQ(whole("~/a.lsp"), in("home/a.lsp"));
    EXPECT_EQ(whole("~/deep/../a.lsp"), in("home/a.lsp"));
    folder.write("current/~/a.lsp", "");
    EXPECT_EQ(whole("~/a.lsp"), in("current/~/a.lsp")) << "something has just that name";
}

TEST_F(TypedPath, KeepsLinksAsTheyWereTyped)
{
    fs::create_directory_symlink(folder / "home/deep/folder", folder / "link");
    EXPECT_EQ(whole(in("link/a.lsp")), in("link/a.lsp"));
    EXPECT_EQ(whole(in("link")), in("link"));
    EXPECT_EQ(whole(in("link/../a.lsp")), in("home/deep/a.lsp")) << "which is the file that it leads to";
    fs::create_symlink(folder / "nothing", folder / "broken");
    EXPECT_EQ(whole(in("broken/../a.lsp")), in("a.lsp"));
}

TEST_F(TypedPath, IsNoneInAFolderThatIsGone)
{
    fs::remove_all(folder / "current");
    EXPECT_EQ(whole("a.lsp"), "none");
    EXPECT_EQ(whole("/a.lsp"), "/a.lsp");
    wchar_t path[100] = L"before";
    EXPECT_EQ(tsedTypedPath(L"a.lsp", path, 100), TS_ERROR);
    EXPECT_STREQ(path, L"before");
    EXPECT_EQ(tsedTypedPath(nullptr, path, 100), TS_ERROR);
    EXPECT_EQ(tsedTypedPath(L"/a.lsp", nullptr, 100), TS_ERROR);
}
