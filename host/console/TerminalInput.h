// Characters from standard input, or the news that there is something else to do.
#pragma once

#include "host/console/InputSource.h"

namespace tessel
{
class TerminalInput
{
public:
    enum class Outcome
    {
        kCharacter,
        kInterrupted,
        kEnd // of the input, or of the session
    };

    explicit TerminalInput(InputSource source) : mSource(source) {}

    // Waits for a character in the encoding of the locale; what is no character becomes U+FFFD.
    Outcome read(wchar_t& character);

    // Forgets what was pressed before now.
    void forgetInterrupts() const { mSource.forgetInterrupts(); }

private:
    Outcome readByte(char& byte) const;

    InputSource mSource;
};
} // namespace tessel
