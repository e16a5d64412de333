// How large the terminal is that a descriptor leads to.
#pragma once

#include <optional>

#include <sys/ioctl.h>
#include <unistd.h>

#include "host/text/CommandLine.h"

namespace tessel
{
// Nothing where it leads to no terminal. One that does not know its size counts as 80 by 24.
inline std::optional<ScreenSize> terminalSize(int descriptor)
{
    winsize size{};
    if (!isatty(descriptor))
        return std::nullopt;
    if (ioctl(descriptor, TIOCGWINSZ, &size) != 0 || size.ws_col == 0 || size.ws_row == 0)
        return ScreenSize{80, 24};
    return ScreenSize{size.ws_col, size.ws_row};
}
} // namespace tessel
