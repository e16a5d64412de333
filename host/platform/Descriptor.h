// A descriptor of the system that is closed with its scope.
#pragma once

#include <utility>

#include <unistd.h>

namespace tessel
{
class Descriptor
{
public:
    // Takes over what `open` and its like have answered; a negative number is none.
    explicit Descriptor(int number) : mNumber(number) {}
    ~Descriptor() { close(); }
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

    // False when the system tells only now that something could not be written.
    bool close() { return mNumber < 0 || ::close(std::exchange(mNumber, -1)) == 0; }

private:
    int mNumber;
};
} // namespace tessel
