#include <gmock/gmock.h>

#include <cstdlib>
#include <string>

#include "host/app/PersonalFolders.h"
#include "tests/support/EnvironmentVariable.h"
#include "tests/support/TemporaryFolder.h"

TEST(PersonalFolders, KeepAProfileWhereTheSystemWantsIt)
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

TEST(PersonalFolders, TakeTheMachinesOwnLayoutLastWhateverTheEnvironmentSays)
{
    const EnvironmentVariable folders("XDG_CONFIG_DIRS", "/first:relative:/second");
    EXPECT_THAT(tessel::layoutFolders(""),
                testing::ElementsAre("/second/tessel", "/first/tessel", "/etc/tessel"));
    EXPECT_THAT(tessel::layoutFolders("/to/try"),
                testing::ElementsAre("/second/tessel", "/first/tessel", "/to/try", "/etc/tessel"));
    const EnvironmentVariable none("XDG_CONFIG_DIRS", "");
    EXPECT_THAT(tessel::layoutFolders(""), testing::ElementsAre("/etc/xdg/tessel", "/etc/tessel"));
}

TEST(PersonalFolders, TakeTheFurtherOnesThatALayoutNames)
{
    const TemporaryFolder folder;
    EXPECT_THAT(tessel::furtherLayoutFolders(folder.path()), testing::IsEmpty());
    const std::string begin =
        "Windows Registry Editor Version 5.00\n[HKCU\\Software\\Tessel\\Layout]\n\"Folders\"=";
    folder.write("a.reg", begin + "\"/net/site:relative::/net/office\"");
    EXPECT_THAT(tessel::furtherLayoutFolders(folder.path()),
                testing::ElementsAre("/net/site", "/net/office"));
    folder.write("policy/a.reg", begin + "\"/net/locked\"");
    EXPECT_THAT(tessel::furtherLayoutFolders(folder.path()), testing::ElementsAre("/net/locked"));
}
