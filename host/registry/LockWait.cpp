#include "host/registry/LockWait.h"

#include <algorithm>
#include <thread>
#include <utility>

namespace tessel
{
namespace
{
using std::chrono::milliseconds;

constexpr milliseconds kWithoutAWord{2000};
constexpr int kLongestPause = 25; // milliseconds; the first ones are shorter: most locks last no longer
} // namespace

void LockWait::begin()
{
    mWaited = {};
    mTold = false;
}

bool LockWait::pause(milliseconds moment)
{
    if (mWaited >= mPatience || isUnwanted())
        return false;
    const auto before = Clock::now();
    std::this_thread::sleep_for(std::min<Clock::duration>(moment, mPatience - mWaited));
    mWaited += Clock::now() - before;
    if (mWaited >= kWithoutAWord && !std::exchange(mTold, true))
        mTell(static_cast<bool>(mIsUnwanted));
    return true;
}

int LockWait::attach(sqlite3* database)
{
    const auto wait = [](void* self, int times)
    {
        return static_cast<LockWait*>(self)->pause(milliseconds(std::min(times + 1, kLongestPause))) ? 1 : 0;
    };
    return sqlite3_busy_handler(database, wait, this);
}
} // namespace tessel
