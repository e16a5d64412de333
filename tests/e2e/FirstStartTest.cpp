// The very first start: the profile is empty, and nobody has asked for anything yet.
#include <gtest/gtest.h>

#include "tests/e2e/Applications.h"

TEST(FirstStart, LoadsModrigWithoutAWord)
{
    const HostSession session;
    const auto result = session.run({"APPS"});
    EXPECT_EQ(result.exitStatus, 0);
    EXPECT_EQ(result.output, kBanner + ("Command: APPS\n" + listed(modrigBundle())));
}

TEST(FirstStart, LeavesNoRecordOfModrig)
{
    const HostSession session;
    const auto result = session.run({R"(REGISTRY LIST Software\Tessel\R21)"});
    EXPECT_EQ(result.exitStatus, 0);
    EXPECT_EQ(result.output, kBanner + std::string("Command: REGISTRY LIST Software\\Tessel\\R21\n"
                                                   "[Profiles]\n"));
    EXPECT_EQ(session.run({std::string("REGISTRY LIST ") + kRecordKey}).exitStatus, 1);
}

TEST(FirstStart, MakesTheKeyOfModrigInTheProfileAndStoresNothingThere)
{
    const HostSession session;
    const std::string list = R"(REGISTRY LIST Software\Tessel\R21\Profiles\Default\Dialogs)";
    const auto result = session.run({list, list + "\\Modrig"});
    EXPECT_EQ(result.exitStatus, 0);
    EXPECT_EQ(result.output, kBanner + ("Command: " + list + "\n[Modrig]\nCommand: " + list + "\\Modrig\n"));
}

TEST(FirstStart, KnowsTheCommandWhichSaysThatThereIsNoDisplay)
{
    const HostSession session;
    const auto result = session.run({"HELP MODRIG", "modrig"});
    EXPECT_EQ(result.exitStatus, 0);
    EXPECT_EQ(result.output, kBanner + std::string("Command: HELP MODRIG\n") +
                                 "MODRIG: Loads and unloads applications, in a dialog\nUsage: MODRIG\n"
                                 "Command: modrig\n"
                                 "Tessel cannot open a window: there is no display.\n");
}

TEST(FirstStart, LoadsModrigInSafeModeWhenItIsAskedFor)
{
    HostSession session;
    session.alwaysWith({"--safe"});
    const auto result = session.run({"APPS", "MODRIG", "APPS"});
    EXPECT_EQ(result.exitStatus, 0);
    EXPECT_EQ(result.output, kBanner +
                                 std::string("Command: APPS\nNo application is loaded.\nCommand: MODRIG\n"
                                             "Tessel cannot open a window: there is no display.\n"
                                             "Command: APPS\n") +
                                 listed(modrigBundle()));
}
