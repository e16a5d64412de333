#include "host/console/InputSource.h"

#include <array>
#include <cerrno>

#include <poll.h>
#include <unistd.h>

namespace tessel
{
InputSource::Outcome InputSource::wait() const
{
    std::array<pollfd, 3> sources = {
        {{STDIN_FILENO, POLLIN, 0}, {mInterruptKey, POLLIN, 0}, {mEndRequest, POLLIN, 0}}};
    while (poll(sources.data(), sources.size(), -1) < 0)
        if (errno != EINTR)
            return Outcome::kEnd;
    if (sources[2].revents != 0)
        return Outcome::kEnd;
    return sources[1].revents != 0 ? Outcome::kInterrupted : Outcome::kReady;
}

std::size_t InputSource::read(char* bytes, std::size_t size) const
{
    ssize_t count = 0;
    do
        count = ::read(STDIN_FILENO, bytes, size);
    while (count < 0 && errno == EINTR);
    return count > 0 ? static_cast<std::size_t>(count) : 0;
}

void InputSource::forgetInterrupts() const
{
    std::array<char, 64> notes;
    while (mInterruptKey >= 0 && ::read(mInterruptKey, notes.data(), notes.size()) > 0)
    {
    }
}
} // namespace tessel
