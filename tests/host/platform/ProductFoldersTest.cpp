#include <gtest/gtest.h>

#include "host/platform/ProductFolders.h"

TEST(ProductFolders, FindsThePartsBesideThePrograms)
{
    const auto folders = tessel::productFoldersOf("/moved/Tessel.app");
    EXPECT_EQ(folders.resources, "/moved/Tessel.app/Resources");
    EXPECT_EQ(folders.plugIns, "/moved/Tessel.app/PlugIns");
}

TEST(ProductFolders, FindsThePartsOfABundleInItsContents)
{
    const auto folders = tessel::productFoldersOf("/moved/Tessel.app/Contents/MacOS");
    EXPECT_EQ(folders.resources, "/moved/Tessel.app/Contents/Resources");
    EXPECT_EQ(folders.plugIns, "/moved/Tessel.app/Contents/PlugIns");
}
