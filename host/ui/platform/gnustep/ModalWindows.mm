// A window that runs modally belongs to the one that ran before it, which cannot be used meanwhile. The
// toolkit tells the window manager nothing of this: a click on the window behind raised it over the one that
// waits for an answer, and the program looked hung. It also keeps modal windows out of the task bar, where a
// person looks for a dialog that has got lost.
#import <AppKit/AppKit.h>
#import <GNUstepGUI/GSDisplayServer.h>

#include <map>

#include <tesselui/tsuieach.h>

#include "host/platform/gnustep/StandIn.h"
#include "host/ui/platform/gnustep/Behaviour.h"
#include "host/ui/platform/gnustep/WindowDevice.h"
#include "host/ui/platform/gnustep/WindowHints.h"

namespace tessel::windowing
{
namespace
{
using BeginModalSession = NSModalSession (*)(id, SEL, NSWindow*);
using EndModalSession = void (*)(id, SEL, NSModalSession);
using OrderWindow = void (*)(id, SEL, int, int, int);
using SetWindowLevel = void (*)(id, SEL, int, int);
using PerformMiniaturize = void (*)(id, SEL, id);
BeginModalSession toolkitBeginModalSession;
EndModalSession toolkitEndModalSession;
OrderWindow toolkitOrderWindow;
SetWindowLevel toolkitSetWindowLevel;
PerformMiniaturize toolkitPerformMiniaturize;

// The windows that run modally, each with the one that it belongs to.
std::map<NSWindow*, NSWindow*> gOwners;

NSWindow* ownerOf(NSWindow* window)
{
    const auto found = gOwners.find(window);
    return found == gOwners.end() ? nil : found->second;
}

// A button that opens a window has not been let go, for the toolkit, before that window closes.
void releaseButtons(NSView* view)
{
    if ([view isKindOfClass:[NSButton class]] && [[(NSButton*)view cell] isHighlighted])
    {
        [[(NSButton*)view cell] setHighlighted:NO];
        [view setNeedsDisplay:YES];
    }
    for (NSView* part : tsuiEach<NSView*>([view subviews]))
        releaseButtons(part);
}

void centerOn(NSWindow* owner, NSWindow* window)
{
    const NSRect outer = [owner frame];
    const NSRect screen = [[owner screen] visibleFrame];
    const NSSize size = [window frame].size;
    const CGFloat left = NSMidX(outer) - size.width / 2;
    const CGFloat bottom = NSMidY(outer) - size.height / 2;
    [window setFrameOrigin:NSMakePoint(MAX(NSMinX(screen), MIN(left, NSMaxX(screen) - size.width)),
                                       MAX(NSMinY(screen), MIN(bottom, NSMaxY(screen) - size.height)))];
}

NSModalSession beginModalSession(id application, SEL selector, NSWindow* window)
{
    NSWindow* owner = [application modalWindow];
    if (owner && owner != window)
    {
        gOwners[window] = owner;
        releaseButtons([owner contentView]);
        [owner displayIfNeeded];
        [owner flushWindow];
    }
    return toolkitBeginModalSession(application, selector, window);
}

void endModalSession(id application, SEL selector, NSModalSession session)
{
    gOwners.erase([application modalWindow]);
    toolkitEndModalSession(application, selector, session);
}

void orderWindow(id server, SEL selector, int place, int otherWindow, int number)
{
    NSWindow* window = place == NSWindowOut ? nil : GSWindowWithNumber(number);
    if (window && !isOnScreen(deviceOf(window), [server serverDevice]))
    {
        NSWindow* owner = ownerOf(window);
        introduceWindow(deviceOf(window), deviceOf(owner), [server serverDevice]);
        if (owner)
            centerOn(owner, window);
    }
    toolkitOrderWindow(server, selector, place, otherWindow, number);
}

// The order of windows is the window manager's, by who belongs to whom.
void setWindowLevel(id server, SEL selector, int level, int number)
{
    const bool asUsual = level != NSModalPanelWindowLevel || ![server handlesWindowDecorations];
    toolkitSetWindowLevel(server, selector, asUsual ? level : NSNormalWindowLevel, number);
}

// What the toolkit does when the window manager has put a window away. While the program waits for one, there
// is nothing else that it could do, and its prompt does not answer.
void performMiniaturize(id window, SEL selector, id sender)
{
    if ([NSApp modalWindow])
        [window orderFrontRegardless];
    else
        toolkitPerformMiniaturize(window, selector, sender);
}
} // namespace

void keepModalWindowsInFront()
{
    toolkitBeginModalSession =
        standInFor("NSApplication", @selector(beginModalSessionForWindow:), beginModalSession);
    toolkitEndModalSession = standInFor("NSApplication", @selector(endModalSession:), endModalSession);
    toolkitOrderWindow = standInFor("XGServer", @selector(orderwindow:::), orderWindow);
    toolkitSetWindowLevel = standInFor("XGServer", @selector(setwindowlevel::), setWindowLevel);
    toolkitPerformMiniaturize = standInFor("NSWindow", @selector(performMiniaturize:), performMiniaturize);
}
} // namespace tessel::windowing
