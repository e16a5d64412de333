// The system asks the host to end: a logout, a terminal that closes.
#include <csignal>

#include <gmock/gmock.h>

#include "tests/e2e/Applications.h"
#include "tests/e2e/HostTerminal.h"

using testing::HasSubstr;

namespace
{
constexpr int kEndedBySigterm = 128 + SIGTERM;
constexpr int kEndedBySighup = 128 + SIGHUP;

class Signals : public testing::TestWithParam<int>
{
protected:
    HostSession session;
};
} // namespace

TEST_P(Signals, EndAHostThatWaitsForALine)
{
    HostTerminal terminal(session);
    ASSERT_TRUE(terminal.awaitPrompt());
    kill(terminal.process(), GetParam());
    EXPECT_EQ(terminal.waitForEnd(), 128 + GetParam()) << terminal.screen();
}

TEST_P(Signals, KeepWhatWasTypedAndStored)
{
    {
        HostTerminal terminal(session);
        ASSERT_TRUE(terminal.awaitPrompt());
        terminal.type("REGISTRY SET Software\\Mine name kept\r");
        ASSERT_TRUE(terminal.awaitPrompt());
        terminal.type("LOAD " + fixtureModule("Good.zmb") + "\r");
        ASSERT_TRUE(terminal.shows("is loaded.")) << terminal.screen();
        ASSERT_TRUE(terminal.awaitPrompt());
        kill(terminal.process(), GetParam());
        EXPECT_EQ(terminal.waitForEnd(), 128 + GetParam());
        EXPECT_THAT(terminal.screen(), HasSubstr("Good.zmb: message 2"));
    }
    HostTerminal next(session);
    ASSERT_TRUE(next.awaitPrompt());
    next.type("\x1b[A"); // the up arrow
    EXPECT_TRUE(next.shows("LOAD")) << next.screen();
    next.type(kControlC);
    ASSERT_TRUE(next.awaitPrompt());
    next.type("REGISTRY GET Software\\Mine name\r");
    EXPECT_TRUE(next.shows("kept")) << next.screen();
}

TEST_P(Signals, EndAHostWhoseLispRunsAway)
{
    HostTerminal terminal(session);
    ASSERT_TRUE(terminal.awaitPrompt());
    terminal.type(kRunaway + "\r");
    ASSERT_TRUE(terminal.shows("begun")) << terminal.screen();
    kill(terminal.process(), GetParam());
    EXPECT_EQ(terminal.waitForEnd(), 128 + GetParam());
}

TEST_P(Signals, EndAHostWhoseLispCleansUpForEver)
{
    HostTerminal terminal(session);
    ASSERT_TRUE(terminal.awaitPrompt());
    terminal.type("(unwind-protect (progn (princ \"be\") (princ \"gun\") (loop)) (loop))\r");
    ASSERT_TRUE(terminal.shows("begun")) << terminal.screen();
    kill(terminal.process(), GetParam());
    EXPECT_EQ(terminal.waitForEnd(), 128 + GetParam());
}

// The first file is stopped; the one after it would run away as well.
TEST_P(Signals, EndAHostWhoseSuiteRunsAway)
{
    const auto endless = session.folder().write("endless.lsp", "(princ \"be\") (princ \"gun\") (loop)\n");
    const auto second = session.folder().write("second.lsp", "(princ \"sec\") (princ \"ond\") (loop)\n");
    storeSuite(session, {endless.string(), second.string()});
    HostTerminal terminal(session);
    ASSERT_TRUE(terminal.shows("begun")) << terminal.screen();
    kill(terminal.process(), GetParam());
    EXPECT_EQ(terminal.waitForEnd(), 128 + GetParam());
    EXPECT_EQ(terminal.screen().find("second"), std::string::npos) << terminal.screen();
}

TEST_P(Signals, KeepTheRestOfABatchFromRunning)
{
    HostTerminal terminal(session, {"-c", kRunaway, "-c", "VERSION"});
    ASSERT_TRUE(terminal.shows("begun")) << terminal.screen();
    kill(terminal.process(), GetParam());
    EXPECT_EQ(terminal.waitForEnd(), 128 + GetParam());
    EXPECT_EQ(terminal.screen().find("Command: VERSION"), std::string::npos) << terminal.screen();
}

INSTANTIATE_TEST_SUITE_P(Of, Signals, testing::Values(SIGTERM, SIGHUP),
                         [](const auto& signal) { return signal.param == SIGTERM ? "Logout" : "Hangup"; });

TEST(SignalsOnce, BothAtOnceAreOne)
{
    const HostSession session;
    HostTerminal terminal(session);
    ASSERT_TRUE(terminal.awaitPrompt());
    for (const int signal : {SIGTERM, SIGHUP, SIGTERM, SIGHUP})
        kill(terminal.process(), signal);
    EXPECT_THAT(terminal.waitForEnd(), testing::AnyOf(kEndedBySigterm, kEndedBySighup));
}

// As with `nohup`.
TEST(SignalsOnce, AreLeftAloneWhereTheyAreToBeIgnored)
{
    HostSession session;
    session.startBy("trap '' HUP; exec \"$0\" \"$@\"");
    HostTerminal terminal(session);
    ASSERT_TRUE(terminal.awaitPrompt());
    kill(terminal.process(), SIGHUP);
    terminal.type("(+ 30 12)\r");
    EXPECT_TRUE(terminal.shows("\n42")) << terminal.screen();
    EXPECT_EQ(terminal.quit(), 0);
}
