#include "host/console/Console.h"

#include <cstdint>
#include <optional>
#include <sstream>
#include <utility>

#include "host/console/LineEditor.h"
#include "host/console/TypedHistory.h"
#include "host/messages/Questions.h"
#include "host/platform/OrdinaryFile.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr std::uintmax_t kLargestScript = std::uintmax_t{32} << 20;

// The next line, in the one encoding and with the one kind of line break.
std::optional<std::wstring> nextLine(std::istream& lines)
{
    std::string utf8;
    if (!std::getline(lines, utf8))
        return std::nullopt;
    if (utf8.ends_with('\r'))
        utf8.pop_back();
    return toWide(utf8);
}

void startLine(CommandLine& commandLine)
{
    if (!commandLine.atLineStart())
        commandLine.print(L"\n");
}

class PersonAtTerminal : public Answerer
{
public:
    PersonAtTerminal(LineEditor& editor, CommandLine& commandLine)
        : mEditor(editor), mCommandLine(commandLine)
    {
    }

    std::optional<std::wstring> answer(const std::wstring& prompt) override
    {
        startLine(mCommandLine);
        std::wstring line;
        if (mEditor.readAnswer(prompt, line) == LineEditor::Outcome::kLine)
            return line;
        mEditor.forgetInterrupts(); // it was meant for this question
        mCommandLine.print(L"\n");
        return std::nullopt;
    }

    bool isPerson() const override { return true; }

private:
    LineEditor& mEditor;
    CommandLine& mCommandLine;
};

class FollowingLines : public Answerer
{
public:
    FollowingLines(std::istream& lines, CommandLine& commandLine, const LineRunner& runner)
        : mLines(lines), mCommandLine(commandLine), mRunner(runner)
    {
    }

    std::optional<std::wstring> answer(const std::wstring& prompt) override
    {
        startLine(mCommandLine);
        mCommandLine.print(prompt);
        const auto line = mRunner.isEnding() ? std::nullopt : nextLine(mLines);
        mCommandLine.print(line.value_or(L"") + L"\n");
        return line;
    }

    bool isPerson() const override { return false; }

private:
    std::istream& mLines;
    CommandLine& mCommandLine;
    const LineRunner& mRunner;
};
} // namespace

Console::Console(CommandLine& commandLine, Questions& questions, LineRunner& runner)
    : mCommandLine(commandLine), mQuestions(questions), mRunner(runner)
{
}

void Console::converse(LineEditor& editor, TypedHistory& history)
{
    InputAssembler input;
    PersonAtTerminal person(editor, mCommandLine);
    const Questions::Asked asked(mQuestions, person);
    while (!mRunner.isEnding())
    {
        std::wstring line;
        makeRoomForPrompt(prompt(input));
        editor.forgetInterrupts();
        mRunner.lineBegins();
        auto outcome = editor.read(prompt(input), line, input.begun());
        if (outcome == LineEditor::Outcome::kLine)
        {
            mCommandLine.tell(history.add(line));
            if (mRunner.isLineInterrupted()) // nobody wants what they have stopped before it ran
                outcome = LineEditor::Outcome::kInterrupted;
        }
        if (outcome != LineEditor::Outcome::kLine)
            mCommandLine.print(L"\n");
        if (outcome == LineEditor::Outcome::kEnd)
            return;
        if (outcome == LineEditor::Outcome::kInterrupted)
        {
            input.discard();
            continue;
        }
        if (const auto whole = input.add(line))
            mRunner.run(*whole);
    }
}

bool Console::runLines(std::istream& lines)
{
    FollowingLines following(lines, mCommandLine, mRunner);
    const Questions::Asked asked(mQuestions, following);
    return runEach(lines);
}

bool Console::runEach(std::istream& lines)
{
    bool allWell = true;
    InputAssembler input;
    while (!mRunner.isEnding())
    {
        const auto line = nextLine(lines);
        if (!line)
            break;
        echo(input, *line);
        if (const auto whole = input.add(*line))
            allWell = mRunner.run(*whole) && allWell;
    }
    return !tellIfUnfinished(input) && allWell;
}

bool Console::runLine(std::string_view line)
{
    std::istringstream lines{std::string(line)};
    return runEach(lines);
}

Result<> Console::runScript(const std::filesystem::path& script)
{
    auto text = readOrdinaryFile(script, kLargestScript);
    if (!text)
        return Failure{L"The script " + toWide(script.string()) + L" cannot be read: " + text.sentence() +
                       L"."};
    std::istringstream lines(*std::move(text));
    return runLines(lines) ? Result<>() : Failure{};
}

const wchar_t* Console::prompt(const InputAssembler& input) const
{
    return input.isOpen() ? kContinuationPrompt : kPrompt;
}

// Lisp files end with the host's prompt printed by themselves: then the line is taken over. Anything else on
// the line is left alone.
void Console::makeRoomForPrompt(const wchar_t* prompt)
{
    if (mCommandLine.openLine() == prompt)
        mCommandLine.returnToLineStart();
    else
        startLine(mCommandLine);
}

void Console::echo(const InputAssembler& input, const std::wstring& line)
{
    if (mCommandLine.openLine() != prompt(input))
    {
        makeRoomForPrompt(prompt(input));
        mCommandLine.print(prompt(input));
    }
    mCommandLine.print(line + L"\n");
}

bool Console::tellIfUnfinished(const InputAssembler& input)
{
    if (input.isOpen())
        mCommandLine.say(L"The Lisp expression is not finished: the input ends inside of it.");
    return input.isOpen();
}
} // namespace tessel
