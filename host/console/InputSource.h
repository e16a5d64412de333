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
        kBytes,
        kInterrupted,
        kWoken, // by what was given to `wokenBy`
        kEnd    // of the input, or of the session
    };

    // Descriptors, -1 for none. `interruptKey` does not block, and can be read from when the key was pressed;
    // `endRequest` when the session is to end.
    InputSource(int interruptKey, int endRequest);

    // The same from another descriptor than standard input, which may be one that does not block.
    InputSource from(int input) const;

    // The same that comes back when this descriptor can be read from, too; -1 for none.
    InputSource wokenBy(int descriptor) const;

    // Waits for bytes, and takes at most `size` of them; `count` is set for kBytes only, and not 0 then.
    Outcome read(char* bytes, std::size_t size, std::size_t& count) const;

    // Forgets what was pressed before now.
    void forgetInterrupts() const;

private:
    Outcome wait() const;

    int mInput;
    int mInterruptKey;
    int mEndRequest;
    int mWake = -1;
};
} // namespace tessel
