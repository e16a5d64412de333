#include "host/console/Console.h"

#include <cstdint>
#include <optional>
#include <sstream>
#include <utility>

#include "host/commands/TypedLine.h"
#include "host/console/LineEditor.h"
#include "host/console/TypedHistory.h"
#include "host/messages/Questions.h"
#include "host/platform/OrdinaryFile.h"
#include "host/text/Translation.h"
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

} // namespace

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
        const auto line = mRunner.isEnding() ? std::nullopt : next();
        mCommandLine.print(line.value_or(L"") + L"\n");
        return line;
    }

    bool isPerson() const override { return false; }

    std::optional<std::wstring> next()
    {
        auto line = nextLine(mLines);
        mTaken += line ? 1 : 0;
        return line;
    }
    // How many lines have been, those of answers among them.
    std::size_t taken() const { return mTaken; }

private:
    std::istream& mLines;
    CommandLine& mCommandLine;
    const LineRunner& mRunner;
    std::size_t mTaken = 0;
};

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
            mCommandLine.noteTyped(prompt(input) + line + L"\n");
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

bool Console::runLines(std::istream& lines, const std::wstring& file)
{
    FollowingLines following(lines, mCommandLine, mRunner);
    const Questions::Asked asked(mQuestions, following);
    return runEach(following, file);
}

bool Console::runEach(FollowingLines& lines, const std::wstring& file)
{
    bool allWell = true;
    InputAssembler input;
    std::size_t begun = 1; // the line in which the input begins
    while (!mRunner.isEnding())
    {
        begun = input.isOpen() ? begun : lines.taken() + 1;
        const auto line = lines.next();
        if (!line)
            break;
        if (!isForPrograms(*line))
            echo(input, *line);
        if (const auto whole = input.add(*line))
            allWell = runAt(file, begun, *whole) && allWell;
    }
    return tellIfUnfinished(file, begun, input) && allWell;
}

// What goes wrong is told with its place, if the lines are those of a file.
bool Console::runAt(const std::wstring& file, std::size_t line, const std::wstring& input)
{
    if (file.empty())
        return mRunner.run(input);
    const CommandLine::Place place(mCommandLine, file + L":" + std::to_wstring(line));
    return mRunner.run(input);
}

bool Console::runLine(std::string_view line)
{
    std::istringstream lines{std::string(line)};
    FollowingLines nobody(lines, mCommandLine, mRunner);
    return runEach(nobody, {});
}

Result<> Console::runScript(const std::filesystem::path& script)
{
    auto text = readOrdinaryFile(script, kLargestScript);
    if (!text)
        return Failure{translated(L"The script {} cannot be read: {}.", script, text.sentence())};
    std::istringstream lines(*std::move(text));
    return runLines(lines, toWide(script.string())) ? Result<>() : Failure{};
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

// Nobody has asked for what they have written themselves.
void Console::echo(const InputAssembler& input, const std::wstring& line)
{
    if (mCommandLine.isQuiet())
        return;
    if (mCommandLine.openLine() != prompt(input))
    {
        makeRoomForPrompt(prompt(input));
        mCommandLine.print(prompt(input));
    }
    mCommandLine.print(line + L"\n");
}

// True when nothing is left open.
bool Console::tellIfUnfinished(const std::wstring& file, std::size_t line, const InputAssembler& input)
{
    if (!input.isOpen())
        return true;
    const Result<> unfinished =
        Failure{translated(L"The Lisp expression is not finished: the input ends inside of it.")};
    if (file.empty())
        return mCommandLine.tell(unfinished);
    const CommandLine::Place place(mCommandLine, file + L":" + std::to_wstring(line));
    return mCommandLine.tell(unfinished);
}
} // namespace tessel
