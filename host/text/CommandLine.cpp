#include "host/text/CommandLine.h"

#include <utility>
#include <vector>

#include <tessel/tsformat.h>

#include "host/text/Running.h"
#include "host/text/Table.h"
#include "host/text/TerminalText.h"
#include "host/text/Unicode.h"

namespace tessel
{
CommandLine::CommandLine(Sink write, OutputSurroundings surroundings)
    : mWrite(std::move(write)), mSurroundings(std::move(surroundings))
{
}

void CommandLine::print(std::wstring_view text)
{
    if (text.empty())
        return;
    const std::wstring shown = forTerminal(text);
    mWrite(toUtf8(shown));
    const auto lastBreak = shown.rfind(L'\n');
    if (lastBreak != shown.npos)
        mOpenLine.clear();
    mOpenLine += shown.substr(lastBreak == shown.npos ? 0 : lastBreak + 1);
}

void CommandLine::returnToLineStart()
{
    mWrite("\r");
    mOpenLine.clear();
}

void CommandLine::say(std::wstring_view sentence)
{
    if (!atLineStart())
        print(L"\n");
    print(sentence);
    print(L"\n");
}

void CommandLine::show(const Table& table)
{
    const auto screen = mSurroundings.screen ? mSurroundings.screen() : std::nullopt;
    for (const auto& line : table.lines(screen ? std::optional(screen->columns) : std::nullopt))
        say(line);
}

bool CommandLine::tell(const Outcome& outcome)
{
    if (!outcome.sentence().empty())
        say(outcome.sentence());
    return static_cast<bool>(outcome);
}
} // namespace tessel

int tsutPrintfArguments(const wchar_t* format, const TsFormatArgument* arguments, std::size_t count)
{
    const std::size_t length = tsutFormatArguments(nullptr, 0, format, arguments, count);
    std::vector<wchar_t> text(length + 1);
    tsutFormatArguments(text.data(), text.size(), format, arguments, count);
    if (auto* commandLine = tessel::running<tessel::CommandLine>())
        commandLine->print({text.data(), length});
    return static_cast<int>(length);
}
