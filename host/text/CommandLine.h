// Where the host's text goes: the terminal, a pipe, or a test's buffer.
#pragma once

#include <functional>
#include <string>
#include <string_view>

#include "host/text/Result.h"

namespace tessel
{
class CommandLine
{
public:
    // `write` receives UTF-8 and must not throw; it is called with whole pieces, in order.
    using Sink = std::function<void(std::string_view)>;

    explicit CommandLine(Sink write);

    // Prints the text as it stands, but for what a terminal would take for orders (see `forTerminal`).
    void print(std::wstring_view text);

    // Goes back to where the open line begins: what is printed next stands in its place.
    void returnToLineStart();

    // Prints one sentence on a line of its own: after a line break if something stands on the line already,
    // and with a line break after it.
    void say(std::wstring_view sentence);

    // Says what went wrong, if anything did. Answers whether all went well.
    bool tell(const Outcome& outcome);

    // Whether the next character starts a line.
    bool atLineStart() const { return mOpenLine.empty(); }

    // What stands on the line that is not ended yet: a console must not print its prompt beside it.
    const std::wstring& openLine() const { return mOpenLine; }

private:
    Sink mWrite;
    std::wstring mOpenLine;
};
} // namespace tessel
