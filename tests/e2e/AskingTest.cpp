// A command that asks: at a terminal, in a script, down a pipe, and where nobody answers.
#include <gmock/gmock.h>

#include "tests/e2e/Applications.h"
#include "tests/e2e/HostTerminal.h"

using testing::HasSubstr;

namespace
{
class Asking : public testing::Test
{
protected:
    Asking() { session.alwaysWith({"--safe"}); }

    HostSession session;
    const std::string load = "LOAD " + inQuotes(fixtureModule("Asks.zmb"));
    const std::string file = session.folder().write("drawing.txt", "").string();
};

class AskingAtTheTerminal : public Asking
{
protected:
    AskingAtTheTerminal()
    {
        EXPECT_TRUE(terminal.awaitPrompt());
        terminal.type(load + "\r");
        EXPECT_TRUE(terminal.awaitPrompt());
        terminal.type("ASKS\r");
        EXPECT_TRUE(terminal.shows("questions begin\r\nName: ")) << terminal.screen();
    }

    HostTerminal terminal{session};
};
} // namespace

TEST_F(AskingAtTheTerminal, WaitsForEachAnswerAndTakesDefaults)
{
    terminal.type("moon\r");
    ASSERT_TRUE(terminal.shows("Size <2.5>: ")) << terminal.screen();
    terminal.type("\r");
    ASSERT_TRUE(terminal.shows("Keep it? [Yes/No] <No>: ")) << terminal.screen();
    terminal.type("y\r");
    ASSERT_TRUE(terminal.shows("File: ")) << terminal.screen();
    terminal.type(file + "\r");
    EXPECT_TRUE(terminal.shows("name moon, size 2.5, kept, file " + file + ", cancelled 0"))
        << terminal.screen();
    EXPECT_TRUE(terminal.awaitPrompt());
    EXPECT_EQ(terminal.quit(), 0);
}

TEST_F(Asking, UnderstandsThePersonsLanguageAndThatOfScripts)
{
    session.set("LC_ALL", "de_DE");
    for (const std::string yes : {"j", "ja", "yes"})
    {
        const auto result = session.runScript(load + "\nASKS\nmoon\n\n" + yes + "\n" + file + "\n");
        EXPECT_THAT(result.output, HasSubstr("Keep it? [Ja/Nein] <Nein>: "));
        EXPECT_THAT(result.output, HasSubstr("size 2.5, kept, file " + file)) << yes;
    }
}

TEST_F(AskingAtTheTerminal, AsksAgainForWhatDoesNotFit)
{
    terminal.type("moon\r");
    ASSERT_TRUE(terminal.shows("Size <2.5>: "));
    terminal.type("big\r");
    ASSERT_TRUE(terminal.shows("This is no number: \"big\".\r\nSize <2.5>: ")) << terminal.screen();
    terminal.type("3\rmaybe\r");
    ASSERT_TRUE(terminal.shows("This is neither yes nor no: \"maybe\".\r\nKeep it?")) << terminal.screen();
    terminal.type("n\rnothing.txt\r");
    ASSERT_TRUE(terminal.shows("There is no file \"nothing.txt\".\r\nFile: ")) << terminal.screen();
    terminal.type(".\r");
    ASSERT_TRUE(terminal.shows("\".\" is a folder and no file.\r\nFile: ")) << terminal.screen();
    terminal.type(kControlC);
    EXPECT_TRUE(terminal.shows("size 3, not kept, file , cancelled 1")) << terminal.screen();
    EXPECT_EQ(terminal.quit(), 0);
}

TEST_F(Asking, IsNotDoneWhereTheDefaultHasNoRoomForItsAnswer)
{
    HostTerminal terminal(session);
    EXPECT_TRUE(terminal.awaitPrompt());
    terminal.type(load + "\r");
    EXPECT_TRUE(terminal.awaitPrompt());
    terminal.type("ASKSINNOROOM\r");
    EXPECT_TRUE(terminal.shows("text 2, file 2\r\n")) << terminal.screen();
    EXPECT_TRUE(terminal.awaitPrompt());
    EXPECT_EQ(terminal.quit(), 0);
}

TEST_F(Asking, TakesADefaultThatJustHasRoomForItsAnswer)
{
    const auto result = session.run({load, "ASKSINJUSTROOM"});
    EXPECT_THAT(result.output, HasSubstr("text 0 abc, file 0 /ab\n"));
}

TEST_F(AskingAtTheTerminal, CancelsWithControlCHoweverOftenAndGoesOn)
{
    for (const char* next : {"Size <2.5>: ", "Keep it?", "File: ", "cancelled 4"})
    {
        terminal.type(kControlC);
        ASSERT_TRUE(terminal.shows(next)) << terminal.screen();
    }
    EXPECT_TRUE(terminal.awaitPrompt());
    EXPECT_EQ(terminal.quit(), 0);
}

TEST_F(AskingAtTheTerminal, CancelsWithControlDAndGoesOn)
{
    terminal.type(kControlD);
    EXPECT_TRUE(terminal.shows("Size <2.5>: ")) << terminal.screen();
    terminal.type("1\ry\r");
    terminal.type(kControlD);
    EXPECT_TRUE(terminal.shows("name , size 1, kept, file , cancelled 2")) << terminal.screen();
    EXPECT_EQ(terminal.quit(), 0);
}

TEST_F(AskingAtTheTerminal, KeepsAnswersOutOfTheTypedLinesAndCompletesNothing)
{
    terminal.type("LOA\t\r");
    ASSERT_TRUE(terminal.shows("Size <2.5>: ")) << terminal.screen();
    terminal.type("1\rn\r" + file + "\r");
    ASSERT_TRUE(terminal.shows("name LOA, size 1")) << terminal.screen();
    ASSERT_TRUE(terminal.awaitPrompt());
    terminal.type("\x1B[A\r"); // the line before
    EXPECT_TRUE(terminal.shows("questions begin")) << terminal.screen();
}

TEST_F(Asking, TakesTheFollowingLinesOfAScript)
{
    const auto result = session.runScript(load + "\nASKS\nmoon\n\nyes\n" + file + "\nVERSION\n");
    EXPECT_EQ(result.exitStatus, 0);
    EXPECT_THAT(result.output, HasSubstr("Command: ASKS\nquestions begin\nName: moon\nSize <2.5>: \n"
                                         "Keep it? [Yes/No] <No>: yes\nFile: " +
                                         file + "\nname moon, size 2.5, kept, file " + file +
                                         ", cancelled 0\nCommand: VERSION\n"));
}

TEST_F(Asking, IsCancelledAtTheEndOfAPipe)
{
    const auto result = session.runPipe(load + "\nASKS\nmoon\n4\n");
    EXPECT_EQ(result.exitStatus, 0);
    EXPECT_THAT(result.output, HasSubstr("name moon, size 4, not kept, file , cancelled 2\n"));
}

TEST_F(Asking, TakesTheDefaultsInACommandThatIsAnArgument)
{
    const auto result = session.run({load, "ASKS", "VERSION"});
    EXPECT_EQ(result.exitStatus, 0);
    EXPECT_THAT(result.output,
                HasSubstr("questions begin\nName: \nSize <2.5>: 2.5\nKeep it? [Yes/No] <No>: No\n"
                          "File: \nname , size 2.5, not kept, file , cancelled 2\n"));
}
