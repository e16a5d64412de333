#include "host/console/InputSource.h"

#include <array>
#include <cerrno>

#include <poll.h>
#include <unistd.h>

namespace tessel
{
InputSource::InputSource(int interruptKey, int endRequest)
    : mInput(STDIN_FILENO), mInterruptKey(interruptKey), mEndRequest(endRequest)
{
}

InputSource InputSource::from(int input) const
{
    InputSource other = *this;
    other.mInput = input;
    return other;
}

InputSource InputSource::wokenBy(int descriptor) const
{
    InputSource other = *this;
    other.mWake = descriptor;
    return other;
}

InputSource::Outcome InputSource::wait() const
{
    std::array<pollfd, 4> sources = {
        {{mInput, POLLIN, 0}, {mInterruptKey, POLLIN, 0}, {mEndRequest, POLLIN, 0}, {mWake, POLLIN, 0}}};
    while (poll(sources.data(), sources.size(), -1) < 0)
        if (errno != EINTR)
            return Outcome::kEnd;
    if (sources[2].revents != 0)
        return Outcome::kEnd;
    if (sources[1].revents != 0)
        return Outcome::kInterrupted;
    return sources[3].revents != 0 ? Outcome::kWoken : Outcome::kBytes;
}

// A terminal that forgets what was typed, as it does at Ctrl-C, takes away what there was to read.
InputSource::Outcome InputSource::read(char* bytes, std::size_t size, std::size_t& count) const
{
    for (;;)
    {
        if (const Outcome waited = wait(); waited != Outcome::kBytes)
            return waited;
        const ssize_t came = ::read(mInput, bytes, size);
        count = came > 0 ? static_cast<std::size_t>(came) : 0;
        if (came > 0)
            return Outcome::kBytes;
        if (came == 0 || (errno != EINTR && errno != EAGAIN))
            return Outcome::kEnd;
    }
}

void InputSource::forgetInterrupts() const
{
    std::array<char, 64> notes;
    while (mInterruptKey >= 0 && ::read(mInterruptKey, notes.data(), notes.size()) > 0)
    {
    }
}
} // namespace tessel
