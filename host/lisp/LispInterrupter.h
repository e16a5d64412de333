// Stops the Lisp that is running, from a signal handler or from another thread.
//
// Neither may call Lisp. They leave a note in a pipe; a small thread reads it and asks ECL to interrupt the
// thread of Lisp, which then decides whether the note still concerns what it is doing. For the files that
// know ECL.
#pragma once

#include <atomic>
#include <chrono>
#include <mutex>
#include <optional>
#include <thread>

#include <ecl/ecl.h>

namespace tessel
{
class LispInterrupter
{
public:
    // Made on the thread of Lisp; `interrupted` is the Lisp function that runs there when it is interrupted,
    // and is to ask `takeRequest`. Throws std::system_error when the system has no pipe or thread to give.
    explicit LispInterrupter(cl_object interrupted);
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

    // Whether an interrupt was meant for the evaluation that runs; once true for each.
    bool takeRequest() noexcept;

    // Whether the evaluation that runs has taken one.
    bool hasTakenRequest() const noexcept { return mTakenRun == mRun.load(); }

private:
    // Counts up at every beginning and every end: odd while Lisp runs.
    using Run = unsigned;
    static bool isRun(Run run) { return run % 2 != 0; }

    void watch();
    bool isOnItsWay(Run run) const;
    void send(Run run);
    std::optional<Run> receive() const;

    cl_object mInterrupted; // the garbage collector knows both of these by other ways
    cl_object mLisp;
    int mReadEnd = -1;
    int mWriteEnd = -1;
    int mDepth = 0;
    std::atomic<Run> mRun = 0;
    std::atomic<Run> mRequested = 0;
    std::atomic<std::chrono::steady_clock::time_point> mTaken;
    Run mTakenRun = 0; // used by the thread of Lisp only
    Run mSent = 0;     // used by the watcher only
    // Held while an interrupt is sent: the evaluation that it is sent to does not end meanwhile.
    std::mutex mRunChange;
    std::thread mWatcher;
};
} // namespace tessel
