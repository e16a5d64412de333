// Whether the program is to end although something runs in it that does not come back.
#pragma once

namespace tessel
{
// Asks the person at the terminal and waits for the answer; safe in a signal handler, which is the only place
// left to ask from. False without a terminal whose foreground the program has.
bool endIsWanted() noexcept;
} // namespace tessel
