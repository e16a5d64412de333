#include "host/console/StandardOutput.h"

#include <cerrno>
#include <cstdio>
#include <utility>

#include <poll.h>
#include <unistd.h>

#include "host/platform/SystemFailure.h"

namespace tessel
{
namespace
{
// Another program may have set the terminal, which they share, so that it does not wait.
bool canGoOn(int descriptor, int error)
{
    pollfd output{descriptor, POLLOUT, 0};
    return error == EINTR || (error == EAGAIN && (poll(&output, 1, -1) > 0 || errno == EINTR));
}

Result<> writeAll(int descriptor, std::string_view text)
{
    while (!text.empty())
    {
        const ssize_t count = ::write(descriptor, text.data(), text.size());
        if (count < 0 && !canGoOn(descriptor, errno))
            return systemFailure(errno);
        text.remove_prefix(count > 0 ? static_cast<std::size_t>(count) : 0);
    }
    return {};
}
} // namespace

void StandardOutput::write(std::string_view text)
{
    std::fflush(stdout); // what an application has printed by itself comes before it
    auto written = writeAll(mDescriptor, text);
    if (mWritten)
        mWritten = std::move(written);
}
} // namespace tessel
