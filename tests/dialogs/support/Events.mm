#include "tests/dialogs/support/Events.h"

#import <GNUstepGUI/GSDisplayServer.h>

#include <X11/Xlib.h>

#include <algorithm>
#include <initializer_list>

namespace events
{
namespace
{
NSEvent* mouse(NSEventType type, NSWindow* window, NSPoint place, unsigned modifiers, int clicks)
{
    return [NSEvent mouseEventWithType:type
                              location:place
                         modifierFlags:modifiers
                             timestamp:0
                          windowNumber:[window windowNumber]
                               context:[window graphicsContext]
                           eventNumber:0
                            clickCount:clicks
                              pressure:1];
}
} // namespace

void pump()
{
    while (NSEvent* event = [NSApp nextEventMatchingMask:NSAnyEventMask
                                               untilDate:[NSDate distantPast]
                                                  inMode:NSDefaultRunLoopMode
                                                 dequeue:YES])
        [NSApp sendEvent:event];
}

void sendPointerTo(NSView* view, NSPoint place)
{
    const NSPoint point = [[view window] convertBaseToScreen:[view convertPoint:place toView:nil]];
    auto* display = static_cast<Display*>([GSCurrentServer() serverDevice]);
    const int top = static_cast<int>(NSHeight([[NSScreen mainScreen] frame]) - point.y);
    // A pointer that rests has come from somewhere.
    for (const int step : {-1, 0})
    {
        XWarpPointer(display, None, DefaultRootWindow(display), 0, 0, 0, 0, static_cast<int>(point.x) + step,
                     top + step);
        XSync(display, False);
    }
}

void movePointerTo(NSView* view, NSPoint place)
{
    sendPointerTo(view, place);
    pump();
}

std::size_t windowsOnTheScreen()
{
    auto* display = static_cast<Display*>([GSCurrentServer() serverDevice]);
    Window root = 0;
    Window parent = 0;
    Window* windows = nullptr;
    unsigned count = 0;
    XQueryTree(display, DefaultRootWindow(display), &root, &parent, &windows, &count);
    const auto isShown = [display](Window window)
    {
        XWindowAttributes attributes;
        return XGetWindowAttributes(display, window, &attributes) && attributes.map_state == IsViewable;
    };
    const auto shown = std::count_if(windows, windows + count, isShown);
    XFree(windows);
    return static_cast<std::size_t>(shown);
}

bool comesTrue(const std::function<bool()>& condition)
{
    NSDate* end = [NSDate dateWithTimeIntervalSinceNow:8];
    while (!condition() && [end timeIntervalSinceNow] > 0)
    {
        [[NSRunLoop currentRunLoop] runMode:NSDefaultRunLoopMode
                                 beforeDate:[NSDate dateWithTimeIntervalSinceNow:0.05]];
        pump();
    }
    return condition();
}

void postClick(NSView* view, NSPoint place, unsigned modifiers, int clicks)
{
    const NSPoint point = [view convertPoint:place toView:nil];
    for (const NSEventType type : {NSLeftMouseDown, NSLeftMouseUp})
        [NSApp postEvent:mouse(type, [view window], point, modifiers, clicks) atStart:NO];
}

void click(NSView* view, NSPoint place, unsigned modifiers, int clicks)
{
    for (int count = 1; count <= clicks; ++count)
        postClick(view, place, modifiers, count);
    pump();
}

NSPoint placeOnRow(NSTableView* table, NSInteger row)
{
    const NSRect place = [table rectOfRow:row];
    return NSMakePoint(NSMinX(place) + 10, NSMidY(place));
}

void clickRow(NSTableView* table, NSInteger row, unsigned modifiers, int clicks)
{
    click(table, placeOnRow(table, row), modifiers, clicks);
}

void postKey(NSWindow* window, NSString* characters, unsigned modifiers)
{
    [NSApp postEvent:[NSEvent keyEventWithType:NSKeyDown
                                            location:NSZeroPoint
                                       modifierFlags:modifiers
                                           timestamp:0
                                        windowNumber:[window windowNumber]
                                             context:[window graphicsContext]
                                          characters:characters
                         charactersIgnoringModifiers:characters
                                           isARepeat:NO
                                             keyCode:0]
             atStart:NO];
}

void press(NSWindow* window, NSString* characters, unsigned modifiers)
{
    postKey(window, characters, modifiers);
    pump();
}
} // namespace events
