// The reading and writing of very many values in one command: a person is told how far it has come, and can
// stop it. Used by the Registry alone.
#pragma once

#include <atomic>
#include <chrono>
#include <functional>
#include <string>
#include <utility>

namespace tessel
{
class LongWork
{
public:
    using Say = std::function<void(const std::wstring& sentence)>;

    // Says from time to time how far the work has come; until this is called, nobody does.
    void tellBy(Say say) { mSay = std::move(say); }

    void say(const std::wstring& sentence) const
    {
        if (mSay)
            mSay(sentence);
    }

    // Work begins, or goes on: what comes shortly after other work is part of it.
    void begin();
    // Work goes on. Whether a person has waited for a word since it began, or for another one.
    bool isLong();

    // One value more.
    void count();

    bool isInterrupted() const { return mInterrupted == mCommand; }

    // The command is over: what comes next is counted from the beginning and is not interrupted.
    void end();

    // Stops the work, if so much has been done that it is this which the person waits for. Safe in a signal
    // handler and from another thread.
    void interrupt() noexcept;

private:
    using Clock = std::chrono::steady_clock;

    void tell();

    Say mSay;
    std::atomic<unsigned> mValues = 0;
    std::atomic<unsigned> mCommand = 1;     // counts up
    std::atomic<unsigned> mInterrupted = 0; // the last command that was
    Clock::time_point mLast;
    Clock::time_point mTold;
};
} // namespace tessel
