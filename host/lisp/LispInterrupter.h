// Stops the Lisp that is running, from a signal handler or from another thread.
//
// Neither may call Lisp. They leave a note in a pipe; a small thread reads it and has the thread of Lisp
// interrupted, which then decides whether the note still concerns what it is doing. When to interrupt is
// decided here and how is not, so that this can be tried without Lisp.
#pragma once

#include <atomic>
#include <chrono>
#include <functional>
#include <memory>
#include <mutex>
#include <optional>
#include <thread>

#include "host/platform/Pipe.h"
#include "host/text/Result.h"

namespace tessel
{
class LispInterrupter
{
public:
    // What the small thread calls.
    struct Ways
    {
        std::function<void()> begin; // once, before it sends any
        // Interrupts the thread of Lisp, which is to ask `takeRequest` then.
        std::function<void()> send;
        std::function<void()> end; // after the last
        // For what Lisp still does when it was interrupted for good.
        std::chrono::milliseconds timeToCleanUp = std::chrono::seconds(2);
    };

    // Fails when the system has no pipe or thread to give. Why is the end of a sentence.
    static Result<std::unique_ptr<LispInterrupter>> start(Ways ways);
    ~LispInterrupter();
    LispInterrupter(const LispInterrupter&) = delete;
    LispInterrupter& operator=(const LispInterrupter&) = delete;

    // Around every evaluation; these nest.
    void begin();
    void end();

    bool running() const noexcept { return isRun(mRun.load()); }

    // Changes whenever an evaluation begins or ends, those within one aside.
    unsigned evaluations() const noexcept { return mRun.load(); }

    // Safe in a signal handler. Without an evaluation that runs it does nothing.
    void interrupt() noexcept;
    // The same for good: whatever runs of it then, its clean-up too, is interrupted again and again, until it
    // has ended.
    void interruptUntilItEnds() noexcept;

    // Whether an interrupt was meant for the evaluation that runs; once true for each.
    bool takeRequest() noexcept;

    // Whether the evaluation that runs has taken one.
    bool hasTakenRequest() const noexcept { return mTakenRun == mRun.load(); }

private:
    // Counts up at every beginning and every end: odd while Lisp runs.
    using Run = unsigned;
    static bool isRun(Run run) { return run % 2 != 0; }

    LispInterrupter(Ways ways, Pipe notes);
    void watch();
    bool isOnItsWay(Run run) const;
    void send(Run run);
    std::optional<Run> receive() const;
    bool isNoteThereWithin(std::chrono::milliseconds time) const;

    Ways mWays;
    Pipe mNotes;
    int mDepth = 0;
    std::atomic<Run> mRun = 0;
    std::atomic<Run> mRequested = 0;
    std::atomic<bool> mInsists = false;
    std::atomic<std::chrono::steady_clock::time_point> mTaken;
    Run mTakenRun = 0; // used by the thread of Lisp only
    Run mSent = 0;     // used by the watcher only
    // Held while an interrupt is sent: the evaluation that it is sent to does not end meanwhile.
    std::mutex mRunChange;
    std::thread mWatcher;
};
} // namespace tessel
