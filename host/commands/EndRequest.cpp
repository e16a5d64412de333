#include "host/commands/EndRequest.h"

#include <cerrno>
#include <utility>

#include <unistd.h>

namespace tessel
{
static_assert(std::atomic<bool>::is_always_lock_free, "a signal handler must not wait");

EndRequest::EndRequest()
{
    if (auto opened = openPipe())
        mPipe = *std::move(opened);
}

void EndRequest::make() noexcept
{
    if (mMade.exchange(true))
        return;
    const int before = errno;
    // One byte in an empty pipe: this cannot fail, and nobody takes it out.
    [[maybe_unused]] const auto written = write(mPipe.input.number(), "", 1);
    errno = before;
}
} // namespace tessel
