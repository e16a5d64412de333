#include "modrig/dialogs/model/LoadProgress.h"

namespace ModrigUtils
{
namespace
{
using std::chrono::milliseconds;

constexpr milliseconds kBetweenLooks(50);
constexpr milliseconds kBeforeFirstCount(1000);
constexpr milliseconds kBetweenCounts(200);

bool HasCome(LoadProgress::Time& time, LoadProgress::Time now, milliseconds interval)
{
    if (now < time)
        return false;
    time = now + interval;
    return true;
}
} // namespace

LoadProgress::LoadProgress(Time start)
    : mNextLook(start + kBetweenLooks), mNextCount(start + kBeforeFirstCount)
{
}

bool LoadProgress::IsTimeToLook(Time now)
{
    return HasCome(mNextLook, now, kBetweenLooks);
}

bool LoadProgress::IsTimeToTell(Time now)
{
    return HasCome(mNextCount, now, kBetweenCounts);
}
} // namespace ModrigUtils
