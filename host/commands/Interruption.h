// Ctrl-C, for those who can stop in the midst of their work; and what is to be done when nobody does.
#pragma once

#include <atomic>

#include "host/commands/EndRequest.h"

namespace tessel
{
class Interruption
{
public:
    explicit Interruption(const EndRequest& endRequest) : mEndRequest(endRequest) {}
    Interruption(const Interruption&) = delete;
    Interruption& operator=(const Interruption&) = delete;

    // Work that a person waits for, from its making to its end; these nest. Without any, nobody is to stop.
    class Work
    {
    public:
        explicit Work(Interruption& interruption) : mInterruption(interruption) { ++mInterruption.mWorks; }
        ~Work()
        {
            mInterruption.settle();
            --mInterruption.mWorks;
        }
        Work(const Work&) = delete;
        Work& operator=(const Work&) = delete;

    private:
        Interruption& mInterruption;
    };

    // The key was pressed; safe in a signal handler. `evaluations` changes whenever Lisp begins or ends one:
    // that is a sign of life. True when the key was pressed in vain so often that a person must be asked.
    bool press(unsigned evaluations) noexcept;

    // What was to stop has come back.
    void settle() noexcept { mInVain = 0; }

    // Asked by who can stop: whether the key was pressed, or the session's end wished, since this was made.
    class Wish
    {
    public:
        explicit Wish(const Interruption& interruption)
            : mInterruption(interruption), mPresses(interruption.mPresses)
        {
        }
        bool isThere() const
        {
            return mInterruption.mPresses != mPresses || mInterruption.mEndRequest.isMade();
        }

    private:
        const Interruption& mInterruption;
        const unsigned mPresses;
    };

private:
    static constexpr int kInVain = 3;

    const EndRequest& mEndRequest;
    std::atomic<int> mWorks = 0;
    std::atomic<unsigned> mPresses = 0;
    std::atomic<unsigned> mEvaluations = 0; // at the last press
    std::atomic<int> mInVain = 0;
};
} // namespace tessel
