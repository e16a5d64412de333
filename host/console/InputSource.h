// Bytes from standard input, or the news that there is something else to do.
#pragma once

#include <cstddef>

namespace tessel
{
class InputSource
{
public:
    enum class Outcome
    {
        kReady, // bytes can be read, or the end of the input
        kInterrupted,
        kEnd // the session is to end
    };

    // Descriptors, -1 for none. `interruptKey` does not block, and can be read from when the key was pressed;
    // `endRequest` when the session is to end.
    InputSource(int interruptKey, int endRequest) : mInterruptKey(interruptKey), mEndRequest(endRequest) {}

    Outcome wait() const;

    // The number of bytes that came, at most `size`; 0 at the end of the input.
    std::size_t read(char* bytes, std::size_t size) const;

    // Forgets what was pressed before now.
    void forgetInterrupts() const;

private:
    int mInterruptKey;
    int mEndRequest;
};
} // namespace tessel
