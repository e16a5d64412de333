// A host that is killed loses nothing that it has stored, and one that is busy keeps nobody from storing.
#include <gmock/gmock.h>

#include <csignal>

#include "tests/e2e/Applications.h"
#include "tests/e2e/HostTerminal.h"

TEST(KilledHost, KeepsTheStartupSuiteThatWasChangedInIt)
{
    const HostSession session;
    storeSuite(session, {fixtureModule("Good.zmb")});
    {
        HostTerminal terminal(session);
        ASSERT_TRUE(terminal.awaitPrompt());
        terminal.type(setInSuite("NumStartup", "2") + "\r");
        ASSERT_TRUE(terminal.shows("\r\nCommand: ")) << terminal.screen();
        terminal.type(setInSuite("2Startup", lispFixture("good.lsp")) + "\r");
        ASSERT_TRUE(terminal.shows("\r\nCommand: ")) << terminal.screen();
        terminal.type("(progn (princ \"at \") (princ \"work\") (loop))\r");
        ASSERT_TRUE(terminal.shows("at work")) << terminal.screen();
        ASSERT_EQ(kill(terminal.process(), SIGKILL), 0);
        EXPECT_EQ(terminal.waitForEnd(), -SIGKILL);
    }
    const auto result = session.run({"APPS"});
    EXPECT_EQ(result.output, kBanner + std::string("Good.zmb: message 1\ngood.lsp: loaded\n") + kLispReady +
                                 "Command: APPS\n" + listed(modrigBundle()) +
                                 listed(fixtureModule("Good.zmb")) + listed(lispFixture("good.lsp"), "Lisp") +
                                 "Good.zmb: message 2\n");
}

TEST(KilledHost, KeepsTheRecordThatModrigWroteAtItsStart)
{
    const HostSession session;
    storeSuite(session, {lispFixture("endless_loop.lsp")});
    {
        HostTerminal terminal(session);
        ASSERT_TRUE(terminal.shows("endless_loop.lsp: begun")) << terminal.screen();
        ASSERT_EQ(kill(terminal.process(), SIGKILL), 0);
        EXPECT_EQ(terminal.waitForEnd(), -SIGKILL);
    }
    const std::string get = std::string("REGISTRY GET ") + kRecordKey + " LoadReasons";
    EXPECT_THAT(session.start({"--safe", "-c", get}).output, testing::EndsWith("Command: " + get + "\n6\n"));
}

TEST(BusyHost, LeavesTheRegistryToOtherSessionsWhileItsLispRuns)
{
    const HostSession session;
    storeSuite(session, {lispFixture("endless_loop.lsp")});
    HostTerminal terminal(session);
    ASSERT_TRUE(terminal.shows("endless_loop.lsp: begun")) << terminal.screen();
    const std::string set = R"(REGISTRY SET Software\Trial name data)";
    const auto result = session.start({"--safe", "-c", set});
    EXPECT_EQ(result.exitStatus, 0);
    EXPECT_EQ(result.output, kBanner + ("Command: " + set + "\n"));
}
