#import <AppKit/AppKit.h>

#include <tessel/tsformat.h>
#include <tessel/tshostservices.h>
#include <tesselui/tsuidisplay.h>
#include <tesselui/tsuierrors.h>
#include <wincompat/winstring.h>

#include "host/platform/FileNames.h"
#include "host/platform/ToolkitPlaces.h"
#include "host/ui/KeptSignals.h"
#include "host/ui/SessionEnd.h"
#include "host/ui/Waiting.h"
#include "host/ui/Words.h"
#include "host/ui/platform/Scripts.h"
#include "host/ui/platform/TextKeys.h"
#include "host/ui/platform/Windowing.h"

namespace
{
bool gPrepared = false;

NSString* toolkitFolder()
{
    const TsDbHostApplicationServices* services = tsdbHostApplicationServices();
    NSString* profile = wcharToNSString(services ? services->profileFolder() : L"");
    return [profile stringByAppendingPathComponent:[NSString stringWithUTF8String:tessel::kToolkitFolder]];
}

void prepare()
{
    NSAutoreleasePool* pool = [[NSAutoreleasePool alloc] init];
    tessel::nameEveryFile();
    const tessel::KeptSignals signals; // the display's backend would take Ctrl-C and the wish to end
    tessel::windowing::prepareToolkit(toolkitFolder());
    tessel::windowing::chooseLook();
    [NSApplication sharedApplication];
    tessel::windowing::completeLook();
    tessel::windowing::completeBehaviour();
    tessel::windowing::showEveryScript();
    tessel::windowing::takeTextKeys();
    // The host's own loop waits for the terminal, and the toolkit's never runs: this is what that does first.
    [NSApp finishLaunching];
    tessel::closeWindowsWhenTheSessionEnds();
    tessel::storeBeforeEachWait();
    [pool drain];
}

// Closing a window is only asked of the display; what comes back is taken here, since nobody waits for it.
void takeEvents(void*)
{
    while (NSEvent* event = [NSApp nextEventMatchingMask:NSAnyEventMask
                                               untilDate:[NSDate distantPast]
                                                  inMode:NSDefaultRunLoopMode
                                                 dequeue:YES])
        [NSApp sendEvent:event];
}
} // namespace

bool tsuiHasDisplay()
{
    return gPrepared || tessel::windowing::displayIsReachable();
}

bool tsuiPrepareWindows()
{
    if (!tsuiHasDisplay())
    {
        tsutPrintf(L"%s\n", NSStringToWstring(tessel::word(@"NO_DISPLAY")).c_str());
        return false;
    }
    if (!gPrepared)
        prepare();
    gPrepared = true;
    tessel::windowing::comeToFront();
    return true;
}

void tsuiFinishWindows()
{
    if (!gPrepared)
        return;
    NSAutoreleasePool* pool = [[NSAutoreleasePool alloc] init];
    // The windows are closed and their work is done: what fails now is for the log, not for the command.
    if (NSString* error = tsuiErrorOf(takeEvents, nullptr))
        NSLog(@"%@", error);
    tessel::windowing::leaveScreen();
    [pool drain];
}
