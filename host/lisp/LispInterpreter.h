// The host's Lisp, as its users and applications know it: typed expressions, the queue, called functions.
#pragma once

#include <atomic>
#include <cstddef>
#include <deque>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "host/commands/Interruption.h"
#include "host/commands/RunningMarker.h"
#include "host/text/Result.h"

struct TsResultBuffer;

namespace tessel
{
class Admission;
class CommandLine;
class Document;
class EndRequest;
class LispLoads;
class LispMachine;
class LoadOutcomes;
struct LispSurroundings;

class LispInterpreter
{
public:
    struct Options
    {
        bool removingTsLisp = true;       // compiled and packaged Lisp can be loaded
        std::size_t heapBytes = 0;        // memory for Lisp's objects; 0: as much as is usual
        LoadOutcomes* outcomes = nullptr; // where it is noted how loading files went
        Admission* admission = nullptr;   // of files, if it is to be asked; it marks them, too
    };

    // Lisp itself starts with the first expression: most sessions have none. From then on everything but
    // `interrupt` is to be called on that thread. A later interpreter in the same process finds none of an
    // earlier one's definitions. One at a time.
    //
    // What Lisp prints and what is said of errors goes to the command line, what it has loaded into the
    // document. When the end is requested the queue stops.
    LispInterpreter(const Options& options, CommandLine& commandLine, Document& document,
                    const EndRequest& endRequest);
    ~LispInterpreter();
    LispInterpreter(const LispInterpreter&) = delete;
    LispInterpreter& operator=(const LispInterpreter&) = delete;

    // What a typed line does: every form is evaluated, the printed value is that of the last, empty when
    // there is none to show. What is said of a failure is one line of error text; that Lisp does not start
    // is one, too, and the next expression tries it again. A wish that is there when Lisp begins interrupts
    // it: the key may have been pressed before it runs.
    Result<std::wstring> evaluate(std::wstring_view expressions, const Interruption::Wish* wish = nullptr);

    bool removingTsLisp() const { return mOptions.removingTsLisp; }

    // Expressions for later, when the host is idle. Their values are not printed.
    void queue(std::wstring expression);

    // Evaluates what is queued, in order, and what is queued meanwhile after that. An error is said in one
    // line, and does not keep the next expression from running. Called within itself it does nothing, and
    // when the session is to end nothing more.
    void runQueue();

    // Calls the function named by the first value with the rest. A list comes back with its values in their
    // order, lists within it flattened, and nil within it as TS_NIL. Integers are TS_SHORT if they fit, then
    // TS_LONG; other numbers are TS_REAL, T is TS_TRUE, symbols are strings of their name, and what is none
    // of these is the string that Lisp would print. The values are the caller's to free, null for nil. What
    // is said of a failure is one line of error text.
    Result<TsResultBuffer*> invoke(const TsResultBuffer* call);

    // The symbols that can be typed in the user's package and name something, in small letters; sorted. None
    // when Lisp fails.
    std::vector<std::wstring> symbolsBeginning(std::wstring_view beginning);

    // Stops the evaluation that runs; without one, nothing. Safe in a signal handler and on any thread.
    void interrupt() noexcept;
    // The same, and its clean-up as well when that does not end within some seconds.
    void interruptUntilItEnds() noexcept;
    bool running() const noexcept;

    // Changes whenever an evaluation begins or ends. Safe in a signal handler.
    unsigned evaluations() const noexcept;

private:
    Result<LispMachine*> machine();
    LispSurroundings surroundings();

    struct Queued
    {
        std::wstring expression;
        RunningMarker::Reason reason; // for what it loads
    };

    Options mOptions;
    CommandLine& mCommandLine;
    Document& mDocument;
    const EndRequest& mEndRequest;
    RunningMarker mNoMarker;
    RunningMarker& mMarker;
    std::unique_ptr<LispLoads> mLoads;
    std::unique_ptr<LispMachine> mMachine;       // once it was needed
    std::atomic<LispMachine*> mStarted{nullptr}; // the same, for signal handlers
    std::deque<Queued> mQueue;
    bool mRunningQueue = false;
};
} // namespace tessel
