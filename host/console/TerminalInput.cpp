#include "host/console/TerminalInput.h"

#include <array>
#include <cerrno>
#include <cwchar>

#include <poll.h>
#include <unistd.h>

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
        const Outcome waited = waitForByte();
        if (waited != Outcome::kCharacter)
            return waited;
        const auto byte = readByte();
        if (!byte)
            return Outcome::kEnd;
        const std::size_t used = std::mbrtowc(&character, &*byte, 1, &state);
        if (used == kInvalid)
            character = kReplacement;
        if (used != kIncomplete)
            return Outcome::kCharacter;
    }
}

TerminalInput::Outcome TerminalInput::waitForByte() const
{
    std::array<pollfd, 2> sources = {{{STDIN_FILENO, POLLIN, 0}, {mWakeUp, POLLIN, 0}}};
    while (poll(sources.data(), sources.size(), -1) < 0)
        if (errno != EINTR)
            return Outcome::kEnd;
    return sources[1].revents != 0 ? Outcome::kInterrupted : Outcome::kCharacter;
}

std::optional<char> TerminalInput::readByte() const
{
    char byte = 0;
    ssize_t count = 0;
    do
        count = ::read(STDIN_FILENO, &byte, 1);
    while (count < 0 && errno == EINTR);
    return count == 1 ? std::optional(byte) : std::nullopt;
}

void TerminalInput::forgetInterrupts()
{
    std::array<char, 64> notes;
    while (mWakeUp >= 0 && ::read(mWakeUp, notes.data(), notes.size()) > 0)
    {
    }
}
} // namespace tessel
