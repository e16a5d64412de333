// What a person does with mouse and keyboard in a window that shows, done at once: no modal run is needed.
#pragma once

#import <AppKit/AppKit.h>

#include <functional>

namespace events
{
// Clicks there, in the view's coordinates, so many times as one double or triple click is.
void click(NSView* view, NSPoint place, unsigned modifiers = 0, int clicks = 1);
// A place on the row, in the table's first column.
NSPoint placeOnRow(NSTableView* table, NSInteger row);
// Clicks on the row, there.
void clickRow(NSTableView* table, NSInteger row, unsigned modifiers = 0, int clicks = 1);

void press(NSWindow* window, NSString* characters, unsigned modifiers = 0);

// The same for a run of events that is still to come: a modal one, say. They wait for it.
void postClick(NSView* view, NSPoint place, unsigned modifiers, int clicks);
void postKey(NSWindow* window, NSString* characters, unsigned modifiers);

// Moves the pointer there, in the view's coordinates.
void movePointerTo(NSView* view, NSPoint place);
// The same without dealing with what comes of it.
void sendPointerTo(NSView* view, NSPoint place);

// How many windows the display shows, tips and menus among them.
std::size_t windowsOnTheScreen();

// Goes on until the condition holds; answers false when it does not in some seconds.
bool comesTrue(const std::function<bool()>& condition);

// Deals with everything that waits for the program.
void pump();

inline NSPoint middleOf(NSRect rect)
{
    return NSMakePoint(NSMidX(rect), NSMidY(rect));
}
} // namespace events
