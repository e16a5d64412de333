#include "host/console/Console.h"

#include <cstdint>
#include <sstream>
#include <utility>

#include "host/console/LineEditor.h"
#include "host/console/TypedHistory.h"
#include "host/platform/OrdinaryFile.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr std::uintmax_t kLargestScript = std::uintmax_t{32} << 20;
}

Console::Console(CommandLine& commandLine, LineRunner& runner) : mCommandLine(commandLine), mRunner(runner)
{
}

void Console::converse(LineEditor& editor, TypedHistory& history)
{
    InputAssembler input;
    while (!mRunner.isEnding())
    {
        std::wstring line;
        makeRoomForPrompt(prompt(input));
        editor.forgetInterrupts();
        mRunner.lineBegins();
        auto outcome = editor.read(prompt(input), line);
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
    bool allWell = true;
    InputAssembler input;
    for (std::string utf8; !mRunner.isEnding() && std::getline(lines, utf8);)
    {
        if (utf8.ends_with('\r'))
            utf8.pop_back();
        const std::wstring line = toWide(utf8);
        echo(input, line);
        if (const auto whole = input.add(line))
            allWell = mRunner.run(*whole) && allWell;
    }
    return !tellIfUnfinished(input) && allWell;
}

bool Console::runLine(std::string_view line)
{
    std::istringstream lines{std::string(line)};
    return runLines(lines);
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
    else if (!mCommandLine.atLineStart())
        mCommandLine.print(L"\n");
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
