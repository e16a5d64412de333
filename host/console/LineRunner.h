// What a console drives: something that runs what was typed.
#pragma once

#include <string>

namespace tessel
{
class LineRunner
{
public:
    LineRunner() = default;
    LineRunner(const LineRunner&) = delete;
    LineRunner& operator=(const LineRunner&) = delete;
    virtual ~LineRunner() = default;

    // Runs one command, or Lisp when the text begins with a parenthesis (it may then hold line breaks).
    // False when it was unknown or failed; a sentence has then been said.
    virtual bool run(const std::wstring& input) = 0;

    // Whether a command has asked for the end of the session.
    virtual bool isEnding() const = 0;

    // Stops the Lisp that is running, if any is. Called from a signal handler.
    virtual void interrupt() noexcept = 0;
};
} // namespace tessel
