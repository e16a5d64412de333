#include "host/console/TerminalInput.h"

#include <cwchar>

namespace tessel
{
namespace
{
constexpr wchar_t kReplacement = 0xFFFD;
constexpr auto kIncomplete = static_cast<std::size_t>(-2);
constexpr auto kInvalid = static_cast<std::size_t>(-1);
} // namespace

TerminalInput::Outcome TerminalInput::read(wchar_t& character)
{
    std::mbstate_t state{};
    for (;;)
    {
        char byte = 0;
        if (const Outcome outcome = readByte(byte); outcome != Outcome::kCharacter)
            return outcome;
        const std::size_t used = std::mbrtowc(&character, &byte, 1, &state);
        if (used == kInvalid)
            character = kReplacement;
        if (used != kIncomplete)
            return Outcome::kCharacter;
    }
}

TerminalInput::Outcome TerminalInput::readByte(char& byte) const
{
    const InputSource::Outcome waited = mSource.wait();
    if (waited == InputSource::Outcome::kInterrupted)
        return Outcome::kInterrupted;
    const bool came = waited == InputSource::Outcome::kReady && mSource.read(&byte, 1) == 1;
    return came ? Outcome::kCharacter : Outcome::kEnd;
}
} // namespace tessel
