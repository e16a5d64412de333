// The wish that the session ends, from whoever has it: a command, or a signal from outside.
#pragma once

#include <atomic>

#include "host/platform/Pipe.h"

namespace tessel
{
class EndRequest
{
public:
    EndRequest();
    EndRequest(const EndRequest&) = delete;
    EndRequest& operator=(const EndRequest&) = delete;

    // Safe in a signal handler. A second time it does nothing.
    void make() noexcept;
    bool isMade() const noexcept { return mMade; }

    // Can be read from, and stays so, when the wish has been made: whoever waits for input waits for it, too.
    // -1 when the system has none to give.
    int descriptor() const { return mPipe.output.number(); }

private:
    std::atomic<bool> mMade = false;
    Pipe mPipe;
};
} // namespace tessel
