#include "host/console/InterruptKey.h"

#include <array>
#include <cerrno>

#include <fcntl.h>
#include <unistd.h>

#include "host/console/EndQuestion.h"

namespace tessel
{
namespace
{
// A signal handler can be given nothing.
LineRunner* theKeysRunner = nullptr;
volatile std::sig_atomic_t theWriteEnd = -1;

constexpr int kEndedByKey = 128 + SIGINT; // as shells have it

// What runs would have to come back for a better end.
[[noreturn]] void endAtOnce()
{
    theKeysRunner->noteEndByKey();
    _exit(kEndedByKey);
}

void onKey(int)
{
    const int before = errno;
    if (theKeysRunner->interrupt() && endIsWanted())
        endAtOnce();
    // A pipe that is full has notes enough.
    [[maybe_unused]] const auto written = write(theWriteEnd, "", 1);
    errno = before;
}

void makeIndependent(int descriptor)
{
    fcntl(descriptor, F_SETFD, FD_CLOEXEC);
    fcntl(descriptor, F_SETFL, O_NONBLOCK);
}
} // namespace

InterruptKey::InterruptKey(LineRunner& runner)
{
    theKeysRunner = &runner;
    std::array<int, 2> ends{-1, -1};
    if (pipe(ends.data()) == 0)
        for (const int end : ends)
            makeIndependent(end);
    mReadEnd = ends[0];
    theWriteEnd = ends[1];
    struct sigaction action
    {
    };
    action.sa_handler = onKey;
    sigemptyset(&action.sa_mask);
    sigaction(SIGINT, &action, &mPrevious);
}

InterruptKey::~InterruptKey()
{
    sigaction(SIGINT, &mPrevious, nullptr);
    close(theWriteEnd);
    close(mReadEnd);
    theWriteEnd = -1;
}
} // namespace tessel
