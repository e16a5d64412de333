#include "host/console/InterruptKey.h"

#include <cerrno>
#include <string>
#include <utility>

#include <fcntl.h>
#include <unistd.h>

#include "host/commands/LastWords.h"
#include "host/console/EndQuestion.h"
#include "host/text/Translation.h"

namespace tessel
{
namespace
{
// A signal handler can be given nothing.
LineRunner* theKeysRunner = nullptr;
volatile std::sig_atomic_t theWriteEnd = -1;

constexpr int kEndedByKey = 128 + SIGINT; // as shells have it
std::string theLastLine;                  // made while there is still time to translate it

// Who has sent the signal for the third time means it: there is no other way to tell an application that does
// not come back.
void sayWhyItEnds()
{
    if (sayLastWords(SIGINT))
        return;
    [[maybe_unused]] const auto written = write(STDERR_FILENO, theLastLine.data(), theLastLine.size());
}

// What runs would have to come back for a better end.
void endUnlessSomebodyWaits()
{
    switch (askWhetherToEnd())
    {
    case EndAnswer::kWaitOn:
        return;
    case EndAnswer::kEnd:
        theKeysRunner->noteEndByKey();
        break;
    case EndAnswer::kNobodyToAsk:
        sayWhyItEnds();
        break;
    }
    _exit(kEndedByKey);
}

void onKey(int)
{
    const int before = errno;
    if (theKeysRunner->interrupt())
        endUnlessSomebodyWaits();
    // A pipe that is full has notes enough.
    [[maybe_unused]] const auto written = write(theWriteEnd, "", 1);
    errno = before;
}
} // namespace

InterruptKey::InterruptKey(LineRunner& runner)
{
    theKeysRunner = &runner;
    prepareEndQuestion();
    theLastLine = translatedInUtf8(L"Tessel ends: what is running does not come back.") + "\n";
    if (auto opened = openPipe())
        mPipe = *std::move(opened);
    for (const Descriptor* end : {&mPipe.output, &mPipe.input})
        fcntl(end->number(), F_SETFL, O_NONBLOCK);
    theWriteEnd = mPipe.input.number();
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
    theWriteEnd = -1;
}
} // namespace tessel
