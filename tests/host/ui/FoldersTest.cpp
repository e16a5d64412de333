#include <gmock/gmock.h>

#include "host/ui/platform/gnustep/filepanel/Folders.h"
#include "tests/support/TemporaryFolder.h"

using testing::ElementsAre;
using testing::SizeIs;
using namespace tessel::filepanel;

TEST(WayToAFolder, LeadsFromTheRootToTheFolderItself)
{
    const auto steps = wayTo("/home/me");
    ASSERT_THAT(steps, SizeIs(3));
    EXPECT_EQ("/", steps[0].title);
    EXPECT_EQ("/", steps[0].path);
    EXPECT_EQ("home", steps[1].title);
    EXPECT_EQ("/home", steps[1].path);
    EXPECT_EQ("me", steps[2].title);
    EXPECT_EQ("/home/me", steps[2].path);
    EXPECT_THAT(wayTo("/"), SizeIs(1));
}

TEST(WayToAFolder, LosesItsFirstStepsWhereTheyDoNotFit)
{
    EXPECT_EQ(0u, stepsThatDoNotFit({30, 60, 60}, 150));
    EXPECT_EQ(1u, stepsThatDoNotFit({30, 60, 60}, 149));
    EXPECT_EQ(2u, stepsThatDoNotFit({30, 60, 60}, 119));
    EXPECT_EQ(2u, stepsThatDoNotFit({30, 60, 60}, 10)) << "the folder itself always shows";
    EXPECT_EQ(0u, stepsThatDoNotFit({}, 10));
}

TEST(NearestFolder, IsTheFolderOrTheLastOnTheWayThatIsThere)
{
    const TemporaryFolder folder;
    folder.write("file", "");
    EXPECT_EQ(folder.path().string(), nearestFolder(folder.path().string()));
    EXPECT_EQ(folder.path().string(), nearestFolder((folder / "gone/for/good").string()));
    EXPECT_EQ(folder.path().string(), nearestFolder((folder / "file").string())) << "a file is no folder";
    EXPECT_EQ("/", nearestFolder("/no-such-folder-at-all/x"));
}

TEST(FolderAbove, IsTheRootInTheEnd)
{
    EXPECT_EQ("/home", folderAbove("/home/me"));
    EXPECT_EQ("/", folderAbove("/home"));
    EXPECT_EQ("/", folderAbove("/"));
}

TEST(RecentFolders, HaveTheLastOneFirstAndEachOnce)
{
    EXPECT_THAT(withRecentFolder({"/a", "/b", "/c"}, "/b"), ElementsAre("/b", "/a", "/c"));
    std::vector<std::string> folders;
    for (std::size_t number = 0; number <= kMostRecentFolders; ++number)
        folders = withRecentFolder(folders, "/" + std::to_string(number));
    EXPECT_THAT(folders, SizeIs(kMostRecentFolders));
    EXPECT_EQ("/" + std::to_string(kMostRecentFolders), folders.front());
    EXPECT_EQ("/1", folders.back());
}
