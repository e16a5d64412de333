#include <gmock/gmock.h>

#include <sstream>
#include <vector>

#include "host/commands/EndRequest.h"
#include "host/commands/Interruption.h"
#include "host/console/Console.h"
#include "host/messages/Questions.h"
#include "tests/host/support/HostParts.h"
#include "tests/support/TemporaryFolder.h"

using testing::ElementsAre;
using testing::HasSubstr;
using testing::StartsWith;

namespace
{
// Keeps what it is given; "BAD" fails, which is told, and "QUIT" ends.
class RecordingRunner : public tessel::LineRunner
{
public:
    RecordingRunner(tessel::CommandLine& commandLine, tessel::Questions& questions)
        : mCommandLine(commandLine), mQuestions(questions)
    {
    }

    bool run(const std::wstring& input) override
    {
        inputs.push_back(input);
        mEnding = input == L"QUIT";
        if (input == L"PROMPT")
            mCommandLine.print(L"\nCommand: ");
        if (input == L"OPEN")
            mCommandLine.print(L"no line break");
        if (input == L"ASK")
            answered =
                mQuestions.ask({L"Why", {}, L"so"}, [this](const std::wstring& text) { return take(text); });
        return mCommandLine.tell(input == L"BAD" ? tessel::Result<>(tessel::Failure{L"That is bad."})
                                                 : tessel::Result<>());
    }

    // "NO" does not fit.
    tessel::Result<> take(const std::wstring& text)
    {
        if (text == L"NO")
            return tessel::Failure{L"Not that."};
        answer = text;
        return {};
    }
    void lineBegins() override {}
    bool isLineInterrupted() const override { return false; }
    bool isEnding() const override { return mEnding; }
    bool interrupt() noexcept override { return false; }
    void noteEndByKey() noexcept override {}
    void requestEnd() noexcept override {}
    bool runsLisp() const noexcept override { return false; }

    std::vector<std::wstring> inputs;
    bool answered = false;
    std::wstring answer;

private:
    tessel::CommandLine& mCommandLine;
    tessel::Questions& mQuestions;
    bool mEnding = false;
};

class ConsoleRun : public testing::Test
{
protected:
    bool runLines(const std::string& text)
    {
        std::istringstream lines(text);
        return console.runLines(lines);
    }

    CapturedOutput output;
    tessel::EndRequest endRequest;
    tessel::Interruption interruption{endRequest};
    tessel::Questions questions{output.commandLine(), interruption};
    RecordingRunner runner{output.commandLine(), questions};
    tessel::Console console{output.commandLine(), questions, runner};
};
} // namespace

TEST_F(ConsoleRun, EchoesEachLineAfterThePrompt)
{
    EXPECT_TRUE(runLines("HELP\n\nVERSION"));
    EXPECT_THAT(runner.inputs, ElementsAre(L"HELP", L"VERSION"));
    EXPECT_EQ(output.text(), "Command: HELP\nCommand: \nCommand: VERSION\n");
}

TEST_F(ConsoleRun, AnswersAQuestionWithTheNextLine)
{
    EXPECT_TRUE(runLines("ASK\nbecause\r\nHELP\n"));
    EXPECT_TRUE(runner.answered);
    EXPECT_EQ(runner.answer, L"because");
    EXPECT_THAT(runner.inputs, ElementsAre(L"ASK", L"HELP"));
    EXPECT_EQ(output.text(), "Command: ASK\nWhy <so>: because\nCommand: HELP\n");
}

TEST_F(ConsoleRun, CancelsAQuestionAtTheEndOfTheLines)
{
    EXPECT_TRUE(runLines("ASK\n"));
    EXPECT_FALSE(runner.answered);
    EXPECT_EQ(output.text(), "Command: ASK\nWhy <so>: \n");
}

TEST_F(ConsoleRun, CancelsAQuestionThatALineDoesNotAnswerAndGoesOnWithTheNext)
{
    EXPECT_TRUE(runLines("ASK\nNO\nHELP\n"));
    EXPECT_FALSE(runner.answered);
    EXPECT_THAT(runner.inputs, ElementsAre(L"ASK", L"HELP"));
    EXPECT_EQ(output.text(), "Command: ASK\nWhy <so>: NO\nNot that.\nCommand: HELP\n");
}

TEST_F(ConsoleRun, TakesTheDefaultInALineByItself)
{
    EXPECT_TRUE(console.runLine("ASK\nHELP"));
    EXPECT_TRUE(runner.answered);
    EXPECT_EQ(runner.answer, L"so");
    EXPECT_EQ(output.text(), "Command: ASK\nWhy <so>: so\nCommand: HELP\n");
}

TEST_F(ConsoleRun, ShowsAContinuationPromptInsideOfLisp)
{
    EXPECT_TRUE(runLines("(list\r\n1)\r\n"));
    EXPECT_THAT(runner.inputs, ElementsAre(L"(list\n1)"));
    EXPECT_EQ(output.text(), "Command: (list\n     ... 1)\n");
}

TEST_F(ConsoleRun, DoesNotRepeatAPromptThatStandsThereAlready)
{
    EXPECT_TRUE(runLines("PROMPT\nHELP\n"));
    EXPECT_EQ(output.text(), "Command: PROMPT\n\nCommand: HELP\n");
}

TEST_F(ConsoleRun, StartsThePromptOnALineOfItsOwn)
{
    EXPECT_TRUE(runLines("OPEN\nHELP\n"));
    EXPECT_EQ(output.text(), "Command: OPEN\nno line break\nCommand: HELP\n");
}

TEST_F(ConsoleRun, GoesOnAfterALineThatFails)
{
    EXPECT_FALSE(runLines("BAD\nHELP\n"));
    EXPECT_THAT(runner.inputs, ElementsAre(L"BAD", L"HELP"));
}

TEST_F(ConsoleRun, StopsWhenACommandEndsTheSession)
{
    EXPECT_TRUE(runLines("QUIT\nHELP\n"));
    EXPECT_THAT(runner.inputs, ElementsAre(L"QUIT"));
}

TEST_F(ConsoleRun, SaysWhenTheInputEndsInsideOfLisp)
{
    EXPECT_FALSE(runLines("(list 1\n"));
    EXPECT_THAT(output.text(), HasSubstr("The Lisp expression is not finished"));
}

TEST_F(ConsoleRun, RunsAScriptFromAFile)
{
    const TemporaryFolder folder;
    EXPECT_TRUE(console.runScript(folder.write("größe 100%s.script", "; comment\nHELP\n")));
    EXPECT_THAT(runner.inputs, ElementsAre(L"HELP"));
}

TEST_F(ConsoleRun, TellsWhichLineOfAScriptFailed)
{
    const TemporaryFolder folder;
    const auto script = folder.write("a.scr", "HELP\nASK\nso\n\nBAD\n(list\n");
    EXPECT_FALSE(console.runScript(script));
    EXPECT_THAT(output.text(), HasSubstr("\n" + script.string() + ":5: That is bad.\n"))
        << "an answer is a line";
    EXPECT_THAT(output.text(), HasSubstr("\n" + script.string() + ":6: The Lisp expression is not finished"));
    output.clear();
    EXPECT_FALSE(runLines("BAD\n"));
    EXPECT_EQ(output.text(), "Command: BAD\nThat is bad.\n") << "no file";
}

TEST_F(ConsoleRun, SaysWhyAScriptCannotBeRead)
{
    const TemporaryFolder folder;
    EXPECT_FALSE(output.commandLine().tell(console.runScript(folder / "missing.script")));
    EXPECT_THAT(output.text(), StartsWith("The script " + (folder / "missing.script").string() +
                                          " cannot be read: No such file or directory."));
    output.clear();
    EXPECT_FALSE(output.commandLine().tell(console.runScript(folder.path())));
    EXPECT_THAT(output.text(), HasSubstr("cannot be read: it is a folder, not a file."));
}
