#include "host/platform/RegularFile.h"

#include <fstream>

#include <gtest/gtest.h>

#include "tests/support/TemporaryFolder.h"

using tessel::RegularFile;

namespace
{
class RegularFiles : public testing::Test
{
protected:
    void SetUp() override
    {
        std::filesystem::create_directory(mFolder / "real");
        std::ofstream(mFolder / "real" / "file") << "text";
        std::filesystem::create_directory_symlink("real", mFolder / "linked");
        std::filesystem::create_symlink("file", mFolder / "real" / "link");
    }

    TemporaryFolder mFolder;
};
} // namespace

TEST_F(RegularFiles, TellWhetherALinkLedToThem)
{
    const std::filesystem::path folder = std::filesystem::canonical(mFolder / "real");
    EXPECT_TRUE(RegularFile(folder / "file").reachedDirectly());
    EXPECT_FALSE(RegularFile(folder / "link").reachedDirectly());
    EXPECT_FALSE(RegularFile(folder.parent_path() / "linked" / "file").reachedDirectly());
    EXPECT_FALSE(RegularFile(folder / "missing").reachedDirectly());
}

TEST_F(RegularFiles, AreTheSameByWhateverPath)
{
    const RegularFile direct(mFolder / "real" / "file");
    for (const auto& path : {mFolder / "real" / "link", mFolder / "linked" / "file"})
    {
        const RegularFile linked(path);
        EXPECT_TRUE(linked.opened());
        EXPECT_EQ(linked.identity(), direct.identity());
        EXPECT_EQ(linked.size(), 4U);
    }
}

TEST_F(RegularFiles, AreRefusedWhenTheyAreFoldersReachedDirectlyOrNot)
{
    for (const char* name : {"real", "linked"})
        EXPECT_EQ(RegularFile(mFolder / name).opened().sentence(), L"it is a folder, not a file");
}
