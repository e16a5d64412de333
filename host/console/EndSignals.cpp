#include "host/console/EndSignals.h"

#include <atomic>
#include <ctime>

#include "host/commands/LastWords.h"

namespace tessel
{
namespace
{
// A signal handler can be given nothing.
LineRunner* theRunner = nullptr;
std::atomic<int> theSignal = 0; // several threads may take one each
std::atomic<time_t> theFirstSecond = 0;
constexpr time_t kPatienceSeconds = 1; // and up to one more

static_assert(std::atomic<int>::is_always_lock_free && std::atomic<time_t>::is_always_lock_free,
              "a signal handler must not wait");

// Both may come together, and a terminal that closes may send its own twice: that means no more hurry. Who
// asks again some time later means it, where the code of an application, or Lisp, does not come back.
bool isAskedAgain()
{
    timespec now = {};
    clock_gettime(CLOCK_MONOTONIC, &now);
    time_t first = 0;
    return !theFirstSecond.compare_exchange_strong(first, now.tv_sec) &&
           now.tv_sec - first > kPatienceSeconds;
}

void endAtOnce(int signal)
{
    struct sigaction usual = {};
    usual.sa_handler = SIG_DFL;
    sigaction(signal, &usual, nullptr);
    raise(signal);
}

void onSignal(int signal)
{
    int none = 0;
    theSignal.compare_exchange_strong(none, signal);
    if (isAskedAgain() && (sayLastWords(signal) || theRunner->runsLisp()))
        endAtOnce(signal);
    theRunner->requestEnd();
}
} // namespace

EndSignals::EndSignals(LineRunner& runner)
{
    theRunner = &runner;
    theSignal = 0;
    theFirstSecond = 0;
    struct sigaction action = {};
    action.sa_handler = onSignal;
    sigemptyset(&action.sa_mask);
    for (std::size_t index = 0; index < kSignals.size(); ++index)
    {
        sigaction(kSignals[index], &action, &mPrevious[index]);
        // Who starts a program so that it outlives its terminal means it.
        if (mPrevious[index].sa_handler == SIG_IGN)
            sigaction(kSignals[index], &mPrevious[index], nullptr);
    }
}

// What ends on a signal goes on to its end: the next one would otherwise cut it short.
EndSignals::~EndSignals()
{
    struct sigaction ignored = {};
    ignored.sa_handler = SIG_IGN;
    for (std::size_t index = 0; index < kSignals.size(); ++index)
        sigaction(kSignals[index], theSignal == 0 ? &mPrevious[index] : &ignored, nullptr);
}

int EndSignals::received()
{
    return theSignal;
}
} // namespace tessel
