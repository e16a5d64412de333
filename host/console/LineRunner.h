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
    // False when it was unknown or failed, which has been told by then.
    virtual bool run(const std::wstring& input) = 0;

    // A person is about to type the next line, and whether Ctrl-C was pressed since. Lisp that is run next
    // stops at once if it was.
    virtual void lineBegins() = 0;
    virtual bool isLineInterrupted() const = 0;

    // Whether the session is to end.
    virtual bool isEnding() const = 0;

    // These are called from a signal handler. The first stops what is running, if that can be stopped: true
    // when it was called in vain so often that a person is to be asked whether to end the program. The second
    // is told when they want that: the program ends at once. The third ends the session as soon as what is
    // running has come back.
    virtual bool interrupt() noexcept = 0;
    virtual void noteEndByKey() noexcept = 0;
    virtual void requestEnd() noexcept = 0;
    // Whether Lisp is running. Safe in a signal handler, too.
    virtual bool runsLisp() const noexcept = 0;
};
} // namespace tessel
