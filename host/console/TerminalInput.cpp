#include "host/console/TerminalInput.h"

#include <cwchar>

#include <fcntl.h>
#include <unistd.h>

namespace tessel
{
namespace
{
constexpr wchar_t kReplacement = 0xFFFD;
constexpr auto kIncomplete = static_cast<std::size_t>(-2);
constexpr auto kInvalid = static_cast<std::size_t>(-1);

// None where the system does not say which terminal it is, or where it is another person's.
Descriptor openTerminal()
{
    const char* name = ttyname(STDIN_FILENO);
    return Descriptor(name ? open(name, O_RDONLY | O_NONBLOCK | O_NOCTTY | O_CLOEXEC) : -1);
}

TerminalInput::Outcome outcomeOf(InputSource::Outcome outcome)
{
    switch (outcome)
    {
    case InputSource::Outcome::kBytes:
        return TerminalInput::Outcome::kCharacter;
    case InputSource::Outcome::kInterrupted:
        return TerminalInput::Outcome::kInterrupted;
    case InputSource::Outcome::kWoken:
        return TerminalInput::Outcome::kWoken;
    case InputSource::Outcome::kEnd:
        break;
    }
    return TerminalInput::Outcome::kEnd;
}
} // namespace

TerminalInput::TerminalInput(const InputSource& source)
    : mTerminal(openTerminal()), mSource(mTerminal ? source.from(mTerminal.number()) : source)
{
}

TerminalInput::Outcome TerminalInput::read(wchar_t& character)
{
    std::mbstate_t state{};
    for (;;)
    {
        char byte = 0;
        std::size_t count = 0;
        if (const auto outcome = mSource.read(&byte, 1, count); outcome != InputSource::Outcome::kBytes)
            return outcomeOf(outcome);
        const std::size_t used = std::mbrtowc(&character, &byte, 1, &state);
        if (used == kInvalid)
            character = kReplacement;
        if (used != kIncomplete)
            return Outcome::kCharacter;
    }
}
} // namespace tessel
