// A descriptor of the system that is closed with its scope.
#pragma once

#include <cerrno>
#include <string_view>
#include <utility>

#include <unistd.h>

#include "host/platform/SystemFailure.h"
#include "host/text/Result.h"

namespace tessel
{
class Descriptor
{
public:
    // Takes over what `open` and its like have answered; a negative number is none.
    explicit Descriptor(int number) : mNumber(number) {}
    ~Descriptor()
    {
        if (mNumber >= 0)
            ::close(mNumber);
    }
    Descriptor(Descriptor&& other) noexcept : mNumber(std::exchange(other.mNumber, -1)) {}
    Descriptor& operator=(Descriptor&& other) noexcept
    {
        std::swap(mNumber, other.mNumber);
        return *this;
    }
    Descriptor(const Descriptor&) = delete;
    Descriptor& operator=(const Descriptor&) = delete;

    explicit operator bool() const { return mNumber >= 0; }
    int number() const { return mNumber; }

    // All of it. Fails with the system's words.
    Result<> write(std::string_view bytes) const
    {
        while (!bytes.empty())
        {
            const ssize_t count = ::write(mNumber, bytes.data(), bytes.size());
            if (count < 0 && errno != EINTR)
                return systemFailure(errno);
            bytes.remove_prefix(count > 0 ? static_cast<std::size_t>(count) : 0);
        }
        return {};
    }

    // Fails when the system tells only now that something could not be written.
    Result<> close()
    {
        if (mNumber >= 0 && ::close(std::exchange(mNumber, -1)) != 0)
            return systemFailure(errno);
        return {};
    }

private:
    int mNumber;
};
} // namespace tessel
