// The waiting for a lock on the registry's file that another program holds: in small pauses, for a limited
// time, and with a word to the person who waits. Used by the Registry's own files alone.
#pragma once

#include <sqlite3.h>

#include <chrono>
#include <functional>
#include <utility>

namespace tessel
{
class LockWait
{
public:
    using IsUnwanted = std::function<bool()>;

    // Called when a wait has become long.
    using Tell = std::function<void(bool canBeStopped)>;

    LockWait(std::chrono::milliseconds patience, Tell tell) : mPatience(patience), mTell(std::move(tell)) {}

    // The waits from now on take no longer than that altogether, however many locks are asked for.
    void begin();

    // Who can stop the waits; nobody, until this is called.
    void letStop(IsUnwanted isUnwanted) { mIsUnwanted = std::move(isUnwanted); }

    // Whether who can stop them wants that now.
    bool isUnwanted() const { return mIsUnwanted && mIsUnwanted(); }

    // Waits for a moment. False, at once, when there has been enough of it.
    bool pause(std::chrono::milliseconds moment);

    // Makes the connection wait in this way, or not at all.
    int attach(sqlite3* database);
    static void detach(sqlite3* database) { sqlite3_busy_handler(database, nullptr, nullptr); }

private:
    using Clock = std::chrono::steady_clock;

    const std::chrono::milliseconds mPatience;
    const Tell mTell;
    IsUnwanted mIsUnwanted;
    Clock::duration mWaited{};
    bool mTold = false;
};
} // namespace tessel
