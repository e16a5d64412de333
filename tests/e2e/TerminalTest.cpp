// A person at a terminal.
#include <gtest/gtest.h>

#include <csignal>
#include <optional>

#include "tests/e2e/HostTerminal.h"

TEST(Terminal, EndsWithControlD)
{
    const HostSession session;
    HostTerminal terminal(session);
    ASSERT_TRUE(terminal.awaitPrompt());
    terminal.type(kControlD);
    EXPECT_EQ(terminal.waitForEnd(), 0);
}

TEST(Terminal, CompletesTheNameOfACommandWithTab)
{
    const HostSession session;
    HostTerminal terminal(session);
    ASSERT_TRUE(terminal.awaitPrompt());
    terminal.type("vers\t\r");
    EXPECT_TRUE(terminal.shows("VERSION ")) << terminal.screen();
    EXPECT_TRUE(terminal.shows("Tessel R21")) << terminal.screen();
}

// Completing a name reads the registry, and what it has read is no part of the command that is being typed.
TEST(Terminal, ReadsWhatAnotherSessionStoredWhileALineWasTyped)
{
    const HostSession session;
    HostTerminal terminal(session);
    ASSERT_TRUE(terminal.awaitPrompt());
    terminal.type("regis\t");
    ASSERT_TRUE(terminal.shows("REGISTRY ")) << terminal.screen();
    ASSERT_EQ(session.start({"--safe", "-c", "REGISTRY SET Software\\Mine name stored"}).exitStatus, 0);
    terminal.type("GET Software\\Mine name\r");
    EXPECT_TRUE(terminal.shows("\nstored")) << terminal.screen();
}

TEST(Terminal, ShowsTheNamesToChooseFrom)
{
    HostSession session;
    session.alwaysWith({"--safe"});
    HostTerminal terminal(session);
    ASSERT_TRUE(terminal.awaitPrompt());
    terminal.type("s\t");
    EXPECT_TRUE(terminal.shows("SCRIPT  SETVAR")) << terminal.screen();
}

TEST(Terminal, StopsRunawayLispWithControlCAndGoesOn)
{
    const HostSession session;
    HostTerminal terminal(session);
    ASSERT_TRUE(terminal.awaitPrompt());
    ASSERT_TRUE(controlCStopsLisp(terminal));
    terminal.type("(* 6 7)\r");
    EXPECT_TRUE(terminal.shows("\n42")) << terminal.screen();
    EXPECT_EQ(terminal.quit(), 0);
}

TEST(Terminal, StopsLispThatRunsAwayWhileTheHostStarts)
{
    const HostSession session;
    const auto lisp =
        session.folder().write("endless.lsp", "(princ \"be\") (princ \"gun\") (loop)\n").string();
    const std::string key = R"(REGISTRY SET Software\Tessel\R21\Profiles\Default\Dialogs\Modrig\Startup )";
    ASSERT_EQ(
        session.start({"--safe", "-c", key + "NumStartup 1", "-c", key + "1Startup " + lisp}).exitStatus, 0);

    HostTerminal terminal(session);
    ASSERT_TRUE(terminal.shows("begun")) << terminal.screen();
    terminal.type(kControlC);
    ASSERT_TRUE(terminal.awaitPrompt());
    EXPECT_EQ(terminal.quit(), 0);
}

TEST(Terminal, GivesAFreshPromptForControlC)
{
    const HostSession session;
    HostTerminal terminal(session);
    ASSERT_TRUE(terminal.awaitPrompt());
    terminal.type("(half an expression\r");
    ASSERT_TRUE(terminal.shows("... ")) << terminal.screen();
    terminal.type(kControlC);
    ASSERT_TRUE(terminal.awaitPrompt());
    ASSERT_TRUE(controlCClearsTheLine(terminal));
    terminal.type("VERSION\r");
    EXPECT_TRUE(terminal.shows("Tessel R21")) << terminal.screen();
    EXPECT_EQ(terminal.quit(), 0);
}

TEST(Terminal, RemembersWhatWasTypedInEarlierSessions)
{
    const HostSession session;
    {
        HostTerminal terminal(session);
        ASSERT_TRUE(terminal.awaitPrompt());
        terminal.type("(list 'übung 17)\r");
        ASSERT_TRUE(terminal.shows("ÜBUNG 17")) << terminal.screen();
        ASSERT_TRUE(terminal.awaitPrompt());
        terminal.type(kControlD);
        ASSERT_EQ(terminal.waitForEnd(), 0);
    }
    HostTerminal terminal(session);
    ASSERT_TRUE(terminal.awaitPrompt());
    terminal.type("\x1b[A"); // the up arrow
    EXPECT_TRUE(terminal.shows("(list 'übung 17)")) << terminal.screen();
}

// As under a shell: a person presses Ctrl-Z, does something else, and goes on.
TEST(Terminal, ShowsThePromptAndWhatWasTypedAfterItWasStopped)
{
    HostSession session;
    session.alwaysWith({"--safe"});
    session.startBy(
        "set -m; \"$0\" \"$@\"; stty -a | tr ' ' '\\n' | grep -x -e -icanon -e icanon; echo away; fg");
    HostTerminal terminal(session);
    ASSERT_TRUE(terminal.awaitPrompt());
    terminal.type("(* 6 7");
    ASSERT_TRUE(terminal.shows("(* 6 7")) << terminal.screen();
    terminal.type("\x1a");
    ASSERT_TRUE(terminal.showsWithin("\nicanon", std::chrono::seconds(10))) << terminal.screen();
    ASSERT_TRUE(terminal.showsWithin("away", std::chrono::seconds(10))) << terminal.screen();
    EXPECT_TRUE(terminal.showsWithin("\rCommand: (* 6 7", std::chrono::seconds(10))) << terminal.screen();
    terminal.type(")\x1b[D\r"); // the keys of a terminal that is edited on
    EXPECT_TRUE(terminal.showsWithin("\n42\r\n", std::chrono::seconds(10))) << terminal.screen();
    EXPECT_EQ(terminal.quit(), 0);
}

namespace
{
// An expression is begun at the prompt.
class TerminalAtWhichOneTypes : public testing::Test
{
protected:
    TerminalAtWhichOneTypes()
    {
        mSession.alwaysWith({"--safe"});
        mTerminal.emplace(mSession);
    }
    void SetUp() override
    {
        ASSERT_TRUE(mTerminal->awaitPrompt());
        mTerminal->type("(* 6 7");
        ASSERT_TRUE(mTerminal->shows("(* 6 7")) << mTerminal->screen();
    }

    HostSession mSession;
    std::optional<HostTerminal> mTerminal;
};
} // namespace

// Nobody can refuse to be stopped so, and whoever was in between may have set the terminal otherwise.
TEST_F(TerminalAtWhichOneTypes, ShowsThePromptAndWhatWasTypedAfterItWasStoppedFromOutside)
{
    kill(mTerminal->process(), SIGSTOP);
    kill(mTerminal->process(), SIGCONT);
    EXPECT_TRUE(mTerminal->showsWithin("Command: (* 6 7", std::chrono::seconds(10))) << mTerminal->screen();
    mTerminal->type(")\r");
    EXPECT_TRUE(mTerminal->showsWithin("\n42\r\n", std::chrono::seconds(10))) << mTerminal->screen();
}

TEST_F(TerminalAtWhichOneTypes, DrawsItAgainWhenTheWindowChanges)
{
    mTerminal->resize({40, 10});
    EXPECT_TRUE(mTerminal->showsWithin("\rCommand: (* 6 7", std::chrono::seconds(10))) << mTerminal->screen();
}
