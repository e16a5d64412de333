// Where the host's text goes: the terminal, a pipe, or a test's buffer.
#pragma once

#include <cstddef>
#include <functional>
#include <optional>
#include <string>
#include <string_view>

#include "host/text/Result.h"

namespace tessel
{
class Table;

// In cells, of which a wide character takes two, and in lines.
struct ScreenSize
{
    std::size_t columns;
    std::size_t rows;
};

// What may be known about where the text goes.
struct OutputSurroundings
{
    std::function<std::optional<ScreenSize>()> screen = {}; // asked each time; nothing: no screen
};

class CommandLine
{
public:
    // Receives UTF-8 and must not throw; it is called with whole pieces, in order.
    using Sink = std::function<void(std::string_view)>;

    explicit CommandLine(Sink write, OutputSurroundings surroundings = {});

    // Prints the text as it stands, but for what a terminal would take for orders (see `forTerminal`).
    void print(std::wstring_view text);

    // Goes back to where the open line begins: what is printed next stands in its place.
    void returnToLineStart();

    // Prints one sentence on a line of its own: after a line break if something stands on the line already,
    // and with a line break after it.
    void say(std::wstring_view sentence);

    // Says a table that was asked for, as wide as the screen; without a screen a row is a line.
    void show(const Table& table);

    // Says what went wrong, if anything did. Answers whether all went well.
    bool tell(const Outcome& outcome);

    // Whether the next character starts a line.
    bool atLineStart() const { return mOpenLine.empty(); }

    // What stands on the line that is not ended yet: a console must not print its prompt beside it.
    const std::wstring& openLine() const { return mOpenLine; }

private:
    Sink mWrite;
    OutputSurroundings mSurroundings;
    std::wstring mOpenLine;
};
} // namespace tessel
