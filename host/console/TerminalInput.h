// Characters from standard input, or the news that there is something else to do.
#pragma once

#include "host/console/InputSource.h"
#include "host/platform/Descriptor.h"

namespace tessel
{
class TerminalInput
{
public:
    enum class Outcome
    {
        kCharacter,
        kInterrupted,
        kWoken, // by a signal that is noted
        kEnd    // of the input, or of the session
    };

    explicit TerminalInput(const InputSource& source);

    // From now on waiting ends when that descriptor can be read from, too; -1: no longer.
    void wakeBy(int descriptor) { mSource = mSource.wokenBy(descriptor); }

    // Waits for a character in the encoding of the locale; what is no character becomes U+FFFD.
    Outcome read(wchar_t& character);

    // Forgets what was pressed before now.
    void forgetInterrupts() const { mSource.forgetInterrupts(); }

private:
    // The terminal opened for ourselves, so that reading does not block while other programs' does.
    Descriptor mTerminal;
    InputSource mSource;
};
} // namespace tessel
