// Lisp itself, apart from what it is used for: ECL started once in the process, with evaluations that always
// come back. Nothing of ECL shows here.
//
// Errors, endless recursion, exhausted memory, calls of the debugger and jumps to nowhere all end in one line
// of text, and the next evaluation finds Lisp in order. What Lisp cannot be kept from: code that turns
// interrupts off and never ends, and code that itself reads or compares data nested millions of levels deep.
#pragma once

#include <cstddef>
#include <filesystem>
#include <functional>
#include <memory>
#include <string>
#include <string_view>

#include "host/commands/Interruption.h"
#include "host/text/Result.h"

struct TsResultBuffer;

namespace tessel
{
inline constexpr std::size_t kLispHeapBytes = std::size_t{512} << 20;

// What Lisp meets when it reaches out. None of the functions may call Lisp.
struct LispSurroundings
{
    bool removingTsLisp = true; // compiled files are loaded, and functions for packaged applications offered
    std::size_t heapBytes = kLispHeapBytes;
    std::function<void(std::wstring_view)> write; // what Lisp prints, in pieces
    std::function<std::size_t()> column;          // characters on the line that is not ended yet
    // About the file of a path as it was given: before it is looked for; when it is refused, with the end of
    // a sentence; when it is loaded without an error; and, before a failure comes back, that this file, which
    // no other file loads, is what failed. Where the words about a file are missing it was refused.
    std::function<void(const std::wstring& path)> fileAsked = {};
    std::function<void(const Failure& reason)> fileRefused = {};
    std::function<void(const std::wstring& path)> fileLoaded = {};
    std::function<void(const std::wstring& path, const std::wstring& words)> fileFailed = {};

    // About files within files, of which the innermost runs. `fileBegins` may refuse the one with that full
    // path before it is opened. `filesOpen` answers how many have begun, and `filesEnd` ends all above that
    // number.
    std::function<Result<>(const std::filesystem::path& file)> fileBegins = {};
    std::function<std::size_t()> filesOpen = {};
    std::function<void(std::size_t)> filesEnd = {};
};

class LispMachine
{
public:
    // Starts Lisp, or takes over the one that is there with a new, empty user package. One at a time; the
    // first decides the thread on which all evaluations run.
    static Result<std::unique_ptr<LispMachine>> start(LispSurroundings surroundings);
    ~LispMachine();
    LispMachine(const LispMachine&) = delete;
    LispMachine& operator=(const LispMachine&) = delete;

    // What each of these says of a failure is one line of error text, with this code where Lisp gave up all
    // that it was doing, and knew no longer where it was.
    static constexpr int kLeftByJump = 2;

    // Every form, one after the other; the printed value of the last, empty where there is none to print.
    // A wish that is there when Lisp begins interrupts it.
    Result<std::wstring> evaluate(std::wstring_view forms, const Interruption::Wish* wish = nullptr);

    // Calls the function named by the first value with the rest. The values are the caller's to free, null
    // for nil.
    Result<TsResultBuffer*> call(const TsResultBuffer* call);

    // The symbols of the user's package that begin so and name something, a line each.
    Result<std::wstring> symbolsBeginning(std::wstring_view beginning);

    // Byte code of a source text, to be packed; `name` is what errors call the text.
    Result<std::wstring> compile(const std::wstring& name, std::wstring_view text);

    // From any thread or signal handler.
    void interrupt() noexcept;
    void interruptUntilItEnds() noexcept;
    bool running() const noexcept;

    // Changes whenever an evaluation begins or ends. Safe in a signal handler.
    unsigned evaluations() const noexcept;

private:
    struct Session;
    explicit LispMachine(std::unique_ptr<Session> session);

    std::unique_ptr<Session> mSession;
};
} // namespace tessel
