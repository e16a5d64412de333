// Messages that Modrig's entry point is sent twice, or does not know. An application of the test sends them
// from within the host (applications/AsksModrig.cpp).
#include <gtest/gtest.h>

#include "tests/e2e/Applications.h"

namespace
{
std::string answers(const HostSession& session, const std::vector<std::string>& commands)
{
    std::vector<std::string> all = {"LOAD " ASKS_MODRIG};
    all.insert(all.end(), commands.begin(), commands.end());
    const auto result = session.run(all);
    EXPECT_EQ(result.exitStatus, 0) << result.output;
    const std::string loaded = "Command: LOAD " ASKS_MODRIG "\n" ASKS_MODRIG " is loaded.\n";
    const std::size_t place = result.output.find(loaded);
    EXPECT_NE(place, std::string::npos) << result.output;
    return result.output.substr(place + loaded.size());
}
} // namespace

TEST(EntryPointOfModrig, AnswersASecondLoadMessageWith3AndDoesNothing)
{
    const HostSession session;
    storeSuite(session, {lispFixture("good.lsp")});
    EXPECT_EQ(answers(session, {"SENDLOAD", "SENDLOAD", "APPS", "MODRIG"}),
              "Command: SENDLOAD\nModrig answered 3.\n"
              "Command: SENDLOAD\nModrig answered 3.\n"
              "Command: APPS\n" +
                  listed(modrigBundle()) + listed(ASKS_MODRIG) + listed(lispFixture("good.lsp"), "Lisp") +
                  "Command: MODRIG\nTessel cannot open a window: there is no display.\n");
}

TEST(EntryPointOfModrig, AnswersUnloadMessages)
{
    const HostSession session;
    EXPECT_EQ(answers(session, {"SENDUNLOAD", "SENDUNLOAD"}), "Command: SENDUNLOAD\nModrig answered 0.\n"
                                                              "Command: SENDUNLOAD\nModrig answered 0.\n");
}

TEST(EntryPointOfModrig, StartsAgainAfterTheHostHasUnloadedIt)
{
    const HostSession session;
    storeSuite(session, {fixtureModule("Good.zmb"), lispFixture("good.lsp")});
    const auto result = session.run({"UNLOAD Modrig.bundle", "MODRIG", "LOAD " + modrigBundle(), "MODRIG"});
    const std::string loadedLisp = std::string("good.lsp: loaded\n") + kLispReady;
    // The code of Objective-C classes cannot be taken out of a process, and the host says so.
    EXPECT_EQ(
        result.output,
        kBanner + ("Good.zmb: message 1\n" + loadedLisp) + "Command: UNLOAD Modrig.bundle\n" +
            "The application \"" + modrigBundle() +
            "\" is out of service; its code stays in memory until the session ends.\n" + modrigBundle() +
            " is unloaded.\nCommand: MODRIG\nTessel cannot open a window: there is no display.\n" +
            loadedLisp + "Command: LOAD " + modrigBundle() + "\n" + modrigBundle() + " is loaded.\n" +
            "Command: MODRIG\nTessel cannot open a window: there is no display.\n" + "Good.zmb: message 2\n");
}

// Its code is still in memory then: the command must be gone all the same.
TEST(EntryPointOfModrig, HasNoCommandBetweenAnUnloadAndALoad)
{
    const HostSession session;
    const auto result = session.run(
        {"UNLOAD Modrig.bundle", "APPS", "MODRIG", "_MODRIG", "LOAD " + modrigBundle(), "APPS", "_MODRIG"});
    EXPECT_EQ(
        result.output,
        kBanner + std::string("Command: UNLOAD Modrig.bundle\nThe application \"") + modrigBundle() +
            "\" is out of service; its code stays in memory until the session ends.\n" + modrigBundle() +
            " is unloaded.\nCommand: APPS\nNo application is loaded.\n"
            "Command: MODRIG\nUnknown command \"MODRIG\". Type HELP for the list of commands.\n"
            "Command: _MODRIG\nUnknown command \"_MODRIG\". Type HELP for the list of commands.\n"
            "Command: LOAD " +
            modrigBundle() + "\n" + modrigBundle() + " is loaded.\nCommand: APPS\n" + listed(modrigBundle()) +
            "Command: _MODRIG\nTessel cannot open a window: there is no display.\n");
}

TEST(EntryPointOfModrig, IgnoresMessagesThatItDoesNotKnow)
{
    const HostSession session;
    EXPECT_EQ(answers(session, {"SENDSEVEN", "MODRIG"}),
              "Command: SENDSEVEN\nModrig answered 0.\n"
              "Command: MODRIG\nTessel cannot open a window: there is no display.\n");
}
