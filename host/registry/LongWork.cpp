#include "host/registry/LongWork.h"

#include "host/text/Translation.h"

namespace tessel
{
namespace
{
constexpr unsigned kLookAtClock = 1024;         // values between two looks
constexpr std::chrono::seconds kPatience{2};    // without a word
constexpr unsigned kWorthInterrupting = 10'000; // values, some hundredths of a second
} // namespace

void LongWork::count()
{
    if (++mValues % kLookAtClock == 1)
        tell();
}

// Values that come now and then, while something else is done, are no work to wait for.
void LongWork::begin()
{
    const auto now = Clock::now();
    if (now - mLast > kPatience)
        mTold = now;
    mLast = now;
}

bool LongWork::isLong()
{
    mLast = Clock::now();
    if (mLast - mTold < kPatience)
        return false;
    mTold = mLast;
    return true;
}

void LongWork::tell()
{
    begin();
    if (!isLong())
        return;
    say(translatedByCount(mValues, L"The registry has read or written {} value so far. Ctrl-C stops it.",
                          L"The registry has read or written {} values so far. Ctrl-C stops it."));
}

void LongWork::end()
{
    mValues = 0; // before: who finds the next command's number is not to find the values of this one
    ++mCommand;
    mLast = {};
}

void LongWork::interrupt() noexcept
{
    const unsigned command = mCommand;
    if (mValues > kWorthInterrupting)
        mInterrupted = command;
}
} // namespace tessel
