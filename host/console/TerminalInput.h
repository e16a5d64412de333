// Characters from standard input, or the news that the interrupt key was pressed.
#pragma once

#include <optional>

namespace tessel
{
class TerminalInput
{
public:
    enum class Outcome
    {
        kCharacter,
        kInterrupted,
        kEnd
    };

    // `wakeUp`: a non-blocking descriptor that can be read from when the key was pressed; -1 for none.
    explicit TerminalInput(int wakeUp) : mWakeUp(wakeUp) {}

    // Waits for a character in the encoding of the locale; what is no character becomes U+FFFD.
    Outcome read(wchar_t& character);

    // Forgets what was pressed before now.
    void forgetInterrupts();

private:
    Outcome waitForByte() const;
    std::optional<char> readByte() const;

    int mWakeUp;
};
} // namespace tessel
