// What a person does with mouse and keyboard in a window that shows, done at once: no modal run is needed.
#pragma once

#import <AppKit/AppKit.h>

namespace events
{
// Clicks there, in the view's coordinates, so many times as one double or triple click is.
void click(NSView* view, NSPoint place, unsigned modifiers = 0, int clicks = 1);
// Clicks on the row, in the table's first column.
void clickRow(NSTableView* table, NSInteger row, unsigned modifiers = 0, int clicks = 1);

void press(NSWindow* window, NSString* characters, unsigned modifiers = 0);

// Deals with everything that waits for the program.
void pump();

inline NSPoint middleOf(NSRect rect)
{
    return NSMakePoint(NSMidX(rect), NSMidY(rect));
}
} // namespace events
