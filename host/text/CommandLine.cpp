#include "host/text/CommandLine.h"

#include <algorithm>
#include <utility>
#include <vector>

#include <tessel/tsformat.h>

#include "host/text/DisplayWidth.h"
#include "host/text/Running.h"
#include "host/text/Table.h"
#include "host/text/TerminalText.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr char kRed[] = "\x1b[31m";
constexpr char kPlainAgain[] = "\x1b[0m";
} // namespace

CommandLine::CommandLine(Sink write, OutputSurroundings surroundings)
    : mWrite(std::move(write)), mSurroundings(std::move(surroundings))
{
}

void CommandLine::write(std::string_view text)
{
    mWrite(text);
    if (mSurroundings.record)
        mSurroundings.record(text);
}

void CommandLine::print(std::wstring_view text)
{
    if (text.empty())
        return;
    const std::wstring shown = forTerminal(text);
    write(toUtf8(shown));
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

// Beside what may be read by a program.
void CommandLine::sayAside(std::wstring_view sentence, Aside kind)
{
    if (!atLineStart())
        print(L"\n");
    const Sink& sink = mSurroundings.errors ? mSurroundings.errors : mWrite;
    const std::string text = toUtf8(forTerminal(sentence));
    const bool isRed = kind == Aside::kError && mSurroundings.colours;
    sink(isRed ? kRed + text + kPlainAgain + "\n" : text + "\n");
    if (mSurroundings.record)
        mSurroundings.record(text + "\n");
}

void CommandLine::warn(std::wstring_view sentence)
{
    sayAside(sentence, Aside::kPlain);
}

void CommandLine::confirm(std::wstring_view sentence)
{
    if (!isQuiet())
        say(sentence);
}

void CommandLine::explain(const std::function<std::wstring()>& sentence)
{
    if (mSurroundings.loudness == Loudness::kTalkative)
        sayAside(sentence(), Aside::kPlain);
}

void CommandLine::show(const Table& table)
{
    const auto screen = mSurroundings.screen ? mSurroundings.screen() : std::nullopt;
    show(table.lines(screen ? std::optional(screen->columns) : std::nullopt));
}

void CommandLine::show(const std::vector<std::wstring>& lines)
{
    const auto screen = mSurroundings.screen ? mSurroundings.screen() : std::nullopt;
    std::size_t rows = 1; // for the prompt
    std::string list;
    for (const auto& line : lines)
    {
        const std::wstring shown = forTerminal(line);
        rows += screen ? 1 + (std::max<std::size_t>(displayWidth(shown), 1) - 1) / screen->columns : 0;
        list += toUtf8(shown) + "\n";
    }
    if (!atLineStart())
        print(L"\n");
    const bool isPaged = screen && rows > screen->rows && mSurroundings.pager && mSurroundings.pager(list);
    if (!isPaged)
        write(list);
    else if (mSurroundings.record)
        mSurroundings.record(list);
}

bool CommandLine::tell(const Outcome& outcome)
{
    if (!outcome.sentence().empty())
        sayAside(mPlaces.empty() ? outcome.sentence() : mPlaces.back() + L": " + outcome.sentence(),
                 Aside::kError);
    return static_cast<bool>(outcome);
}

void CommandLine::noteTyped(std::wstring_view text)
{
    if (mSurroundings.record)
        mSurroundings.record(toUtf8(forTerminal(text)));
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
