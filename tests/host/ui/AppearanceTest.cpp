#include "host/ui/platform/gnustep/Appearance.h"

#include <cstdlib>
#include <filesystem>
#include <fstream>

#include <gtest/gtest.h>

#include "tests/support/ShellProgram.h"

using tessel::windowing::Appearance;
using namespace tessel::windowing;

namespace
{
// A desktop whose portal answers as told, and what the environment says.
class ChosenAppearance : public testing::Test
{
protected:
    void SetUp() override
    {
        mPath = std::getenv("PATH");
        unsetenv("GTK_THEME");
        setenv("PATH", (mFolder.path().string() + ":" + mPath).c_str(), 1);
        setenv("DBUS_SESSION_BUS_ADDRESS", "unix:path=/nowhere", 1);
        answer("(<<uint32 0>>,)");
    }
    void TearDown() override
    {
        setenv("PATH", mPath.c_str(), 1);
        unsetenv("DBUS_SESSION_BUS_ADDRESS");
        unsetenv("GTK_THEME");
    }

    void answer(const std::string& text) { writeProgram(mFolder, "gdbus", "echo '" + text + "'"); }

    TemporaryFolder mFolder;

private:
    std::string mPath;
};
} // namespace

TEST_F(ChosenAppearance, IsLightWithoutAWishForDark)
{
    EXPECT_EQ(Appearance::kLight, chosenAppearance(""));
    EXPECT_EQ(Appearance::kLight, chosenAppearance("auto"));
}

TEST_F(ChosenAppearance, FollowsTheDesktop)
{
    answer("(<<uint32 1>>,)");
    EXPECT_EQ(Appearance::kDark, chosenAppearance("auto"));
    answer("(<<uint32 2>>,)");
    EXPECT_EQ(Appearance::kLight, chosenAppearance("auto"));
}

TEST_F(ChosenAppearance, IsAskedForInOneCallThatWaitsForASecondAtMost)
{
    const auto asked = mFolder / "asked";
    writeProgram(mFolder, "gdbus", "echo \"$*\" >'" + asked.string() + "'");
    EXPECT_EQ(Appearance::kLight, chosenAppearance("auto"));
    std::ifstream file(asked);
    std::string words;
    std::getline(file, words);
    EXPECT_EQ(words, "call --session --timeout 1 --dest org.freedesktop.portal.Desktop --object-path "
                     "/org/freedesktop/portal/desktop --method org.freedesktop.portal.Settings.Read "
                     "org.freedesktop.appearance color-scheme");
}

TEST_F(ChosenAppearance, IsLightWhenNoPortalAnswers)
{
    answer("");
    EXPECT_EQ(Appearance::kLight, chosenAppearance("auto"));
}

TEST_F(ChosenAppearance, DoesNotAskWithoutASessionBus)
{
    answer("(<<uint32 1>>,)");
    unsetenv("DBUS_SESSION_BUS_ADDRESS");
    setenv("XDG_RUNTIME_DIR", mFolder.path().c_str(), 1);
    EXPECT_EQ(Appearance::kLight, chosenAppearance("auto"));
    mFolder.write("bus", "");
    EXPECT_EQ(Appearance::kDark, chosenAppearance("auto"));
    unsetenv("XDG_RUNTIME_DIR");
}

TEST_F(ChosenAppearance, FollowsTheThemeOfTheEnvironmentBeforeTheDesktop)
{
    answer("(<<uint32 1>>,)");
    setenv("GTK_THEME", "Adwaita", 1);
    EXPECT_EQ(Appearance::kLight, chosenAppearance("auto"));
    answer("(<<uint32 2>>,)");
    setenv("GTK_THEME", "Adwaita:dark", 1);
    EXPECT_EQ(Appearance::kDark, chosenAppearance("auto"));
    setenv("GTK_THEME", "Yaru-dark", 1);
    EXPECT_EQ(Appearance::kDark, chosenAppearance("auto"));
}

TEST_F(ChosenAppearance, FollowsTheSettingBeforeAnythingElse)
{
    answer("(<<uint32 1>>,)");
    setenv("GTK_THEME", "Adwaita:dark", 1);
    EXPECT_EQ(Appearance::kLight, chosenAppearance("light"));
    setenv("GTK_THEME", "Adwaita", 1);
    EXPECT_EQ(Appearance::kDark, chosenAppearance("dark"));
}
