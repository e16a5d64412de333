#include "host/commands/Interruption.h"

namespace tessel
{
static_assert(std::atomic<int>::is_always_lock_free && std::atomic<unsigned>::is_always_lock_free,
              "a signal handler must not wait");

bool Interruption::press(unsigned evaluations) noexcept
{
    ++mPresses;
    if (mWorks == 0)
        return false;
    if (mEvaluations.exchange(evaluations) != evaluations)
        mInVain = 0;
    if (++mInVain < kInVain)
        return false;
    mInVain = 0;
    return true;
}
} // namespace tessel
