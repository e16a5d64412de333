#include <gtest/gtest.h>

#include <cstdlib>

#include "host/app/Layout.h"

TEST(Layout, FindsThePartsBesideThePrograms)
{
    const auto layout = tessel::layoutOf("/moved/Tessel.app");
    EXPECT_EQ(layout.resources, "/moved/Tessel.app/Resources");
    EXPECT_EQ(layout.plugIns, "/moved/Tessel.app/PlugIns");
}

TEST(Layout, FindsThePartsOfABundleInItsContents)
{
    const auto layout = tessel::layoutOf("/moved/Tessel.app/Contents/MacOS");
    EXPECT_EQ(layout.resources, "/moved/Tessel.app/Contents/Resources");
    EXPECT_EQ(layout.plugIns, "/moved/Tessel.app/Contents/PlugIns");
}

TEST(Layout, KeepsThePersonsOwnProfileWhereTheSystemWantsIt)
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
