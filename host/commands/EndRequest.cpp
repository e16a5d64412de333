#include "host/commands/EndRequest.h"

#include <cerrno>

#include <fcntl.h>
#include <unistd.h>

namespace tessel
{
static_assert(std::atomic<bool>::is_always_lock_free, "a signal handler must not wait");

EndRequest::EndRequest()
{
    if (pipe(mPipe.data()) != 0)
        mPipe = {-1, -1};
    for (const int end : mPipe)
        fcntl(end, F_SETFD, FD_CLOEXEC);
}

EndRequest::~EndRequest()
{
    for (const int end : mPipe)
        close(end);
}

void EndRequest::make() noexcept
{
    if (mMade.exchange(true))
        return;
    const int before = errno;
    // One byte in an empty pipe: this cannot fail, and nobody takes it out.
    [[maybe_unused]] const auto written = write(mPipe[1], "", 1);
    errno = before;
}
} // namespace tessel
