#include "host/ui/platform/gnustep/filepanel/FolderWatch.h"

#include <filesystem>

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <poll.h>

#include "tests/support/TemporaryFolder.h"

using tessel::filepanel::FolderChanges;
using tessel::filepanel::FolderWatch;
using testing::Each;
using testing::IsEmpty;
using testing::Not;

namespace
{
class WatchedFolder : public testing::Test
{
protected:
    WatchedFolder()
    {
        mPlace.write("outer/inner/a.lsp", "");
        EXPECT_TRUE(mWatch.start(mPlace / "outer/inner"));
    }
    bool hasNews() const
    {
        pollfd news{mWatch.descriptor(), POLLIN, 0};
        return poll(&news, 1, 0) == 1;
    }
    // Of one thing that happens, which has to be told at once.
    FolderChanges told()
    {
        EXPECT_TRUE(hasNews());
        FolderChanges changes = mWatch.take();
        EXPECT_FALSE(hasNews()) << "all of it is told";
        return changes;
    }

    const TemporaryFolder mPlace;
    FolderWatch mWatch;
};
} // namespace

TEST_F(WatchedFolder, IsQuietWhenItIsOnlyLookedAt)
{
    EXPECT_FALSE(hasNews());
    for (const auto& file : std::filesystem::directory_iterator(mPlace / "outer/inner"))
        static_cast<void>(file.status());
    mPlace.write("outer/beside.lsp", "");
    EXPECT_FALSE(hasNews());
    EXPECT_FALSE(mWatch.take().isOther);
}

TEST_F(WatchedFolder, TellsOfFilesThatComeAndGo)
{
    std::filesystem::create_directory(mPlace / "outer/inner/new");
    EXPECT_TRUE(told().isOther);
    std::filesystem::remove(mPlace / "outer/inner/new");
    EXPECT_TRUE(told().isOther);
    std::filesystem::rename(mPlace / "outer/inner/a.lsp", mPlace / "outer/a.lsp");
    EXPECT_TRUE(told().isOther);
    std::filesystem::rename(mPlace / "outer/a.lsp", mPlace / "outer/inner/b.lsp");
    EXPECT_TRUE(told().isOther);
}

TEST_F(WatchedFolder, NamesTheFilesThatAreChangedWhereTheyAre)
{
    mPlace.write("outer/inner/a.lsp", "more");
    FolderChanges changes = told();
    EXPECT_FALSE(changes.isOther);
    EXPECT_THAT(changes.written, testing::AllOf(Not(IsEmpty()), Each("a.lsp")));
    std::filesystem::last_write_time(mPlace / "outer/inner/a.lsp",
                                     std::filesystem::file_time_type::clock::now());
    changes = told();
    EXPECT_FALSE(changes.isOther);
    EXPECT_THAT(changes.written, testing::ElementsAre("a.lsp"));
}

TEST_F(WatchedFolder, TellsWhenItIsGone)
{
    std::filesystem::remove_all(mPlace / "outer/inner");
    EXPECT_TRUE(told().isOther);
}

TEST_F(WatchedFolder, TellsWhenItIsSomewhereElse)
{
    std::filesystem::rename(mPlace / "outer", mPlace / "elsewhere");
    const FolderChanges changes = told();
    EXPECT_TRUE(changes.isOther);
    EXPECT_THAT(changes.written, IsEmpty());
}

TEST_F(WatchedFolder, TellsWhenItMayBeReadAgain)
{
    std::filesystem::permissions(mPlace / "outer/inner", std::filesystem::perms::owner_read);
    EXPECT_TRUE(told().isOther);
}

TEST_F(WatchedFolder, IsLeftForAnother)
{
    EXPECT_TRUE(mWatch.start(mPlace / "outer"));
    mPlace.write("outer/inner/b.lsp", "");
    EXPECT_FALSE(hasNews());
    mPlace.write("outer/b.lsp", "");
    EXPECT_TRUE(told().isOther);
    mWatch.stop();
    EXPECT_EQ(-1, mWatch.descriptor());
}

TEST_F(WatchedFolder, CannotBeAFileOrNothingOrOneOfTheSystemsOwn)
{
    for (const auto& path : {mPlace / "outer/inner/a.lsp", mPlace / "gone", std::filesystem::path("/proc")})
    {
        EXPECT_FALSE(mWatch.start(path)) << path;
        EXPECT_EQ(-1, mWatch.descriptor());
    }
}

TEST(FolderChanges, AddUp)
{
    FolderChanges changes;
    changes.add({true, {"a"}});
    changes.add({false, {"b"}});
    EXPECT_TRUE(changes.isOther);
    EXPECT_THAT(changes.written, testing::ElementsAre("a", "b"));
}
