#include "host/ui/Waiting.h"

#import <AppKit/AppKit.h>

#include <tessel/tssession.h>

#include "host/ui/platform/Windowing.h"

namespace tessel
{
namespace
{
int gQuestions = 0;

void onWait()
{
    // Without a modal window a command goes about its own business, and its end is the host's to notice.
    if ([NSApp modalWindow])
        tsrxBeforeWaiting(gQuestions == 0);
}
} // namespace

void storeBeforeEachWait()
{
    windowing::callBeforeEachWait(onWait);
}

Question::Question()
{
    ++gQuestions;
}

Question::~Question()
{
    --gQuestions;
}
} // namespace tessel
