#include <gtest/gtest.h>

#include <cstdlib>

#include "host/app/ProductFolders.h"

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

TEST(ProductFolders, KeepsThePersonsOwnProfileWhereTheSystemWantsIt)
{
    const char* dataHome = std::getenv("XDG_DATA_HOME");
    const std::string before = dataHome ? dataHome : "";
    setenv("XDG_DATA_HOME", "/data", 1);
    EXPECT_EQ(tessel::personalFolder(), "/data/Tessel");
    setenv("XDG_DATA_HOME", "relative", 1);
    const char* home = std::getenv("HOME");
    EXPECT_EQ(tessel::personalFolder(), std::filesystem::path(home ? home : "") / ".local/share/Tessel");
    dataHome ? setenv("XDG_DATA_HOME", before.c_str(), 1) : unsetenv("XDG_DATA_HOME");
}
