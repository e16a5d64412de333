// Whether the program is to end although something runs in it that does not come back.
#pragma once

namespace tessel
{
enum class EndAnswer
{
    kEnd,
    kWaitOn,
    kNobodyToAsk // there is no terminal whose foreground the program has
};

// Finds the words to ask in, in the person's language; once, before anything is asked.
void prepareEndQuestion();

// Asks the person at the terminal and waits for the answer; safe in a signal handler, which is the only place
// left to ask from.
EndAnswer askWhetherToEnd() noexcept;
} // namespace tessel
