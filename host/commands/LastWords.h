// The last line of a process that an application ends: which application it was, and what it was doing.
//
// A signal then goes its usual way, to a core dump and the exit status that goes with it. `exit` called
// within an application ends the process with a status that tells a failure: whatever the host was to do is
// not done.
#pragma once

#include <array>
#include <csignal>

namespace tessel
{
// From its making to its end; one at a time, on the main thread, before anything else handles such signals.
class LastWords
{
public:
    LastWords();
    ~LastWords();
    LastWords(const LastWords&) = delete;
    LastWords& operator=(const LastWords&) = delete;

private:
    static constexpr std::array kSignals = {SIGSEGV, SIGBUS, SIGABRT, SIGFPE, SIGILL,
                                            SIGTRAP, SIGSYS, SIGQUIT, SIGXCPU};

    std::array<struct sigaction, kSignals.size()> mPrevious = {};
    stack_t mPreviousStack = {};
};

// Says the line for an end by that signal. False, and nothing is said, when no application is at work. Safe
// in a signal handler.
bool sayLastWords(int signal);
} // namespace tessel
