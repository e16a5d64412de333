#include <gmock/gmock.h>

#include <sstream>
#include <vector>

#include "host/console/Console.h"
#include "tests/host/support/HostParts.h"
#include "tests/support/TemporaryFolder.h"

using testing::ElementsAre;
using testing::HasSubstr;
using testing::StartsWith;

namespace
{
// Keeps what it is given; "BAD" fails and "QUIT" ends.
class RecordingRunner : public tessel::LineRunner
{
public:
    explicit RecordingRunner(tessel::CommandLine& commandLine) : mCommandLine(commandLine) {}

    bool run(const std::wstring& input) override
    {
        inputs.push_back(input);
        mEnding = input == L"QUIT";
        if (input == L"PROMPT")
            mCommandLine.print(L"\nCommand: ");
        if (input == L"OPEN")
            mCommandLine.print(L"no line break");
        return input != L"BAD";
    }
    void lineBegins() override {}
    bool isLineInterrupted() const override { return false; }
    bool isEnding() const override { return mEnding; }
    bool interrupt() noexcept override { return false; }
    void noteEndByKey() noexcept override {}
    void requestEnd() noexcept override {}
    bool runsLisp() const noexcept override { return false; }

    std::vector<std::wstring> inputs;

private:
    tessel::CommandLine& mCommandLine;
    bool mEnding = false;
};

class Console : public testing::Test
{
protected:
    bool runLines(const std::string& text)
    {
        std::istringstream lines(text);
        return console.runLines(lines);
    }

    CapturedOutput output;
    RecordingRunner runner{output.commandLine()};
    tessel::Console console{output.commandLine(), runner};
};
} // namespace

TEST_F(Console, EchoesEachLineAfterThePrompt)
{
    EXPECT_TRUE(runLines("HELP\n\nVERSION"));
    EXPECT_THAT(runner.inputs, ElementsAre(L"HELP", L"VERSION"));
    EXPECT_EQ(output.text(), "Command: HELP\nCommand: \nCommand: VERSION\n");
}

TEST_F(Console, ShowsAContinuationPromptInsideOfLisp)
{
    EXPECT_TRUE(runLines("(list\r\n1)\r\n"));
    EXPECT_THAT(runner.inputs, ElementsAre(L"(list\n1)"));
    EXPECT_EQ(output.text(), "Command: (list\n     ... 1)\n");
}

TEST_F(Console, DoesNotRepeatAPromptThatStandsThereAlready)
{
    EXPECT_TRUE(runLines("PROMPT\nHELP\n"));
    EXPECT_EQ(output.text(), "Command: PROMPT\n\nCommand: HELP\n");
}

TEST_F(Console, StartsThePromptOnALineOfItsOwn)
{
    EXPECT_TRUE(runLines("OPEN\nHELP\n"));
    EXPECT_EQ(output.text(), "Command: OPEN\nno line break\nCommand: HELP\n");
}

TEST_F(Console, GoesOnAfterALineThatFails)
{
    EXPECT_FALSE(runLines("BAD\nHELP\n"));
    EXPECT_THAT(runner.inputs, ElementsAre(L"BAD", L"HELP"));
}

TEST_F(Console, StopsWhenACommandEndsTheSession)
{
    EXPECT_TRUE(runLines("QUIT\nHELP\n"));
    EXPECT_THAT(runner.inputs, ElementsAre(L"QUIT"));
}

TEST_F(Console, SaysWhenTheInputEndsInsideOfLisp)
{
    EXPECT_FALSE(runLines("(list 1\n"));
    EXPECT_THAT(output.text(), HasSubstr("The Lisp expression is not finished"));
}

TEST_F(Console, RunsAScriptFromAFile)
{
    const TemporaryFolder folder;
    EXPECT_TRUE(console.runScript(folder.write("größe 100%s.script", "; comment\nHELP\n")));
    EXPECT_THAT(runner.inputs, ElementsAre(L"HELP"));
}

TEST_F(Console, SaysWhyAScriptCannotBeRead)
{
    const TemporaryFolder folder;
    EXPECT_FALSE(output.commandLine().tell(console.runScript(folder / "missing.script")));
    EXPECT_THAT(output.text(), StartsWith("The script " + (folder / "missing.script").string() +
                                          " cannot be read: No such file or directory."));
    output.clear();
    EXPECT_FALSE(output.commandLine().tell(console.runScript(folder.path())));
    EXPECT_THAT(output.text(), HasSubstr("cannot be read: it is a folder, not a file."));
}
