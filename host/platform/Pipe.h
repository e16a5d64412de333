// A pipe of the process's own: a program that it starts does not get it.
#pragma once

#include <array>
#include <cerrno>

#include <fcntl.h>
#include <unistd.h>

#include "host/platform/Descriptor.h"
#include "host/platform/SystemFailure.h"
#include "host/text/Result.h"

namespace tessel
{
struct Pipe
{
    Descriptor output{-1}; // what is written to the other end is read here
    Descriptor input{-1};
};

// Fails with the system's words when it has none left.
inline Result<Pipe> openPipe()
{
    std::array<int, 2> ends{};
    if (pipe(ends.data()) != 0)
        return systemFailure(errno);
    for (const int end : ends)
        fcntl(end, F_SETFD, FD_CLOEXEC);
    return Pipe{Descriptor(ends[0]), Descriptor(ends[1])};
}
} // namespace tessel
