#include "tests/ui/support/Events.h"

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

void click(NSView* view, NSPoint place, unsigned modifiers, int clicks)
{
    NSWindow* window = [view window];
    const NSPoint point = [view convertPoint:place toView:nil];
    for (int count = 1; count <= clicks; ++count)
        for (const NSEventType type : {NSLeftMouseDown, NSLeftMouseUp})
            [NSApp postEvent:mouse(type, window, point, modifiers, count) atStart:NO];
    pump();
}

void clickRow(NSTableView* table, NSInteger row, unsigned modifiers, int clicks)
{
    const NSRect place = [table rectOfRow:row];
    click(table, NSMakePoint(NSMinX(place) + 10, NSMidY(place)), modifiers, clicks);
}

void press(NSWindow* window, NSString* characters, unsigned modifiers)
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
    pump();
}
} // namespace events
