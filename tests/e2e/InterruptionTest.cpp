// Ctrl-C at a terminal, pressed once, twice and more often.
#include <gmock/gmock.h>

#include <csignal>
#include <fstream>

#include "tests/e2e/Applications.h"
#include "tests/e2e/HostTerminal.h"

using testing::HasSubstr;
using testing::Not;

namespace
{
constexpr char kQuestion[] =
    "What is running does not come back. End Tessel? What is not stored yet is lost. [y/N] ";
constexpr int kEndedByKey = 128 + SIGINT;
constexpr int kInVain = 3;
constexpr std::chrono::milliseconds kMoment{200};

class Interruption : public testing::Test
{
protected:
    Interruption()
    {
        session.set("HANG_UNTIL", file().string());
        session.alwaysWith({"--safe"});
    }

    std::filesystem::path file() const { return session.folder() / "come back"; }

    // As a person does it: two keys within a moment are one wish. Whether the question came at the last one.
    static bool asksAfter(HostTerminal& terminal, int presses)
    {
        bool asked = false;
        for (int press = 0; press < presses; ++press)
        {
            EXPECT_FALSE(asked) << "after " << press << " times";
            terminal.type(kControlC);
            EXPECT_TRUE(terminal.shows("^C")) << terminal.screen();
            const bool isLast = press + 1 == presses && presses == kInVain;
            asked = terminal.showsWithin(kQuestion, isLast ? kHostTimeLimit : kMoment);
        }
        return asked;
    }

    static void type(HostTerminal& terminal, const std::string& line)
    {
        ASSERT_TRUE(terminal.shows("Command: ")) << terminal.screen();
        terminal.type(line + "\r");
    }

    static void hang(HostTerminal& terminal)
    {
        type(terminal, "LOAD " + fixtureModule("Hangs.zmb"));
        type(terminal, "HANG");
        ASSERT_TRUE(terminal.shows("hanging\r\n")) << terminal.screen();
    }

    void expectGoodEnd(HostTerminal& terminal) const
    {
        type(terminal, "(+ 30 12)");
        EXPECT_TRUE(terminal.shows("\n42")) << terminal.screen();
        type(terminal, "QUIT");
        EXPECT_EQ(terminal.waitForEnd(), 0) << terminal.screen();
    }

    HostSession session;
};
} // namespace

TEST_F(Interruption, StopsACleanUpThatNeverEnds)
{
    HostTerminal terminal(session);
    type(terminal, "(unwind-protect (progn (princ \"be\") (princ \"gun\") (loop)) (princ \"clea\") (princ "
                   "\"ning\") (loop))");
    ASSERT_TRUE(terminal.shows("begun")) << terminal.screen();
    terminal.type(kControlC);
    ASSERT_TRUE(terminal.shows("cleaning")) << terminal.screen();
    // What is pressed while the first one is still on its way is taken for the same wish.
    while (!terminal.showsWithin("Lisp was interrupted.", std::chrono::milliseconds(300)))
        terminal.type(kControlC);
    EXPECT_THAT(terminal.screen(), Not(HasSubstr(kQuestion)));
    expectGoodEnd(terminal);
}

TEST_F(Interruption, AsksWhetherToEndTheHostAtTheThirdTime)
{
    HostTerminal terminal(session);
    hang(terminal);
    ASSERT_TRUE(asksAfter(terminal, kInVain)) << terminal.screen();
    terminal.type("y\r");
    EXPECT_EQ(terminal.waitForEnd(), kEndedByKey) << terminal.screen();
    EXPECT_THAT(
        session.run({}).output,
        testing::HasSubstr("while its command \"HANG\" ran (asked for by hand): you ended it with Ctrl-C. "));
}

TEST_F(Interruption, WaitsOnAfterAnyOtherAnswer)
{
    HostTerminal terminal(session);
    hang(terminal);
    for (const char* answer : {"n\r", "\r", "maybe y\r"})
    {
        ASSERT_TRUE(asksAfter(terminal, kInVain)) << terminal.screen();
        terminal.type(answer);
        ASSERT_TRUE(terminal.shows("Tessel waits on.")) << terminal.screen();
    }
    std::ofstream(file()) << "now";
    ASSERT_TRUE(terminal.shows("back again")) << terminal.screen();
    expectGoodEnd(terminal);
}

TEST_F(Interruption, AnswersAreNotWhatWasTypedBefore)
{
    HostTerminal terminal(session);
    hang(terminal);
    terminal.type("y\ry\r");
    ASSERT_TRUE(asksAfter(terminal, kInVain)) << terminal.screen();
    terminal.type("n\r");
    std::ofstream(file()) << "now";
    ASSERT_TRUE(terminal.shows("back again")) << terminal.screen();
    expectGoodEnd(terminal);
}

TEST_F(Interruption, CountsForEachLineByItself)
{
    HostTerminal terminal(session);
    std::ofstream(file()) << "at once";
    hang(terminal);
    ASSERT_TRUE(terminal.shows("Command: ")) << terminal.screen();
    std::filesystem::remove(file());
    for (int line = 0; line < 2; ++line)
    {
        terminal.type("HANG\r");
        ASSERT_TRUE(terminal.shows("hanging\r\n")) << terminal.screen();
        EXPECT_FALSE(asksAfter(terminal, kInVain - 1)) << terminal.screen();
        std::ofstream(file()) << "now";
        ASSERT_TRUE(terminal.shows("back again")) << terminal.screen();
        ASSERT_TRUE(terminal.shows("Command: ")) << terminal.screen();
        std::filesystem::remove(file());
    }
    EXPECT_THAT(terminal.screen(), Not(HasSubstr(kQuestion)));
    terminal.type(kControlD);
    EXPECT_EQ(terminal.waitForEnd(), 0);
}

TEST_F(Interruption, DoesNotAskAPersonWhoLeansOnTheKeyAtThePrompt)
{
    HostTerminal terminal(session);
    for (int press = 0; press < 10; ++press)
    {
        ASSERT_TRUE(terminal.shows("Command: ")) << terminal.screen();
        terminal.type(kControlC);
    }
    EXPECT_THAT(terminal.screen(), Not(HasSubstr(kQuestion)));
    expectGoodEnd(terminal);
}

// Each of them comes back at the first key.
TEST_F(Interruption, DoesNotAskWhileLispObeys)
{
    const auto lisp =
        session.folder().write("three.script", "(progn (princ \"one\") (finish-output) (loop))\n"
                                               "(progn (princ \"two\") (finish-output) (loop))\n"
                                               "(progn (princ \"three\") (finish-output) (loop))\n"
                                               "(progn (princ \"four\") (finish-output) (loop))\n");
    HostTerminal terminal(session);
    type(terminal, "SCRIPT " + lisp.string());
    for (const char* word : {"one", "two", "three", "four"})
    {
        ASSERT_TRUE(terminal.shows(std::string("\n") + word)) << terminal.screen();
        terminal.type(kControlC);
        ASSERT_TRUE(terminal.shows("Lisp was interrupted.")) << terminal.screen();
    }
    EXPECT_THAT(terminal.screen(), Not(HasSubstr(kQuestion)));
    expectGoodEnd(terminal);
}

// Right after a line, in the same breath: the terminal forgets what was typed, which somebody may be about to
// take.
class InterruptionInTheSameBreath : public Interruption
{
protected:
    InterruptionInTheSameBreath() { session.set("LD_PRELOAD", PRESSES_CONTROL_C); }
};

TEST_F(InterruptionInTheSameBreath, ShowsAPromptWhenTheTerminalForgetsWhatWasTyped)
{
    session.set("PRESS_WHEN", "read");
    HostTerminal terminal(session);
    type(terminal, "(progn (print :ran) (loop))");
    type(terminal, "(+ 30 12)"); // at the next prompt, which comes by itself
    EXPECT_TRUE(terminal.shows("\n42")) << terminal.screen();
    EXPECT_THAT(terminal.screen(), Not(HasSubstr("\n:RAN")));
    EXPECT_EQ(terminal.quit(), 0);
}

TEST_F(InterruptionInTheSameBreath, KeepsTheLineFromRunning)
{
    session.set("PRESS_WHEN", "run");
    HostTerminal terminal(session);
    type(terminal, "(progn (print :ran) (loop))");
    type(terminal, "(+ 30 12)");
    EXPECT_TRUE(terminal.shows("\n42")) << terminal.screen();
    EXPECT_THAT(terminal.screen(), Not(HasSubstr("\n:RAN")));
    EXPECT_EQ(terminal.quit(), 0);
}

// As it happens to a person, who hits another moment each time.
TEST_F(InterruptionInTheSameBreath, LeavesAPromptWheneverItComes)
{
    HostTerminal terminal(session);
    for (int time = 0; time < 300; ++time)
    {
        ASSERT_TRUE(terminal.showsWithin("Command: ", std::chrono::seconds(10))) << time << terminal.screen();
        terminal.type("(loop)\r");
        const auto moment = std::chrono::steady_clock::now() + std::chrono::microseconds(time);
        while (std::chrono::steady_clock::now() < moment)
        {
        }
        terminal.type(kControlC);
    }
}

// Standard input is a file, as in a pipeline or under a service that somebody ends by its key.
class InterruptionWithoutATerminal : public Interruption
{
protected:
    HostResult hangAndPress(int presses)
    {
        std::string counted;
        for (int press = 1; press <= presses; ++press)
            counted += " " + std::to_string(press);
        session.startBy("setsid \"$0\" \"$@\" & until [ -e '" + file().string() +
                        ".begun' ]; do :; done; for press in" + counted +
                        "; do kill -INT $!; sleep 0.1; done; touch '" + file().string() + "'; wait $!");
        const auto result = session.run({"LOAD " + hanging, "HANG"});
        session.startBy("exec \"$0\" \"$@\"");
        return result;
    }

    std::string hanging = fixtureModule("Hangs.zmb");
};

TEST_F(InterruptionWithoutATerminal, EndsTheHostAtTheThirdTimeAndNamesTheApplication)
{
    const auto result = hangAndPress(kInVain);
    EXPECT_EQ(result.exitStatus, kEndedByKey) << result.output;
    EXPECT_THAT(result.output, HasSubstr("hanging\nThe application \"" + hanging +
                                         "\" has ended Tessel while its command \"HANG\" ran: it did not "
                                         "come back (SIGINT).\n"));
    EXPECT_THAT(session.run({}).output,
                HasSubstr("while its command \"HANG\" ran (asked for by hand): it did "
                          "not come back (SIGINT). "));
}

TEST_F(InterruptionWithoutATerminal, GoesOnWhenThereWereFewer)
{
    const auto result = hangAndPress(kInVain - 1);
    EXPECT_EQ(result.exitStatus, 0) << result.output;
    EXPECT_THAT(result.output, HasSubstr("hanging\nback again\n"));
}
