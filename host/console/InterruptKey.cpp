#include "host/console/InterruptKey.h"

namespace tessel
{
namespace
{
LineRunner* theRunner = nullptr; // a signal handler can be given nothing
}

InterruptKey::InterruptKey(LineRunner& runner)
{
    theRunner = &runner;
    // Without SA_RESTART: a console that waits for a line is to wake up and give a fresh prompt.
    struct sigaction action
    {
    };
    action.sa_handler = [](int)
    {
        theRunner->interrupt();
    };
    sigemptyset(&action.sa_mask);
    sigaction(SIGINT, &action, &mPrevious);
}

InterruptKey::~InterruptKey()
{
    sigaction(SIGINT, &mPrevious, nullptr);
}
} // namespace tessel
