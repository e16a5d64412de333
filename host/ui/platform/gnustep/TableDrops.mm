// Where a drop will land in a table. The toolkit counts in whole rows where it should count in quarters, so
// that the lower edge of a row stands for the gap above the row; as long as the pointer stays over a row it
// does not ask again; it marks a row that takes nothing; and the first move over a table it answers by
// itself.
#import <AppKit/AppKit.h>

#include "host/platform/gnustep/StandIn.h"
#include "host/ui/platform/gnustep/Behaviour.h"

namespace tessel::windowing
{
namespace
{
using ProposeDrop = void (*)(id, SEL, NSInteger, NSInteger, NSPoint);
using Hover = NSDragOperation (*)(id, SEL, id);
ProposeDrop toolkitProposeDrop;
Hover toolkitDraggingEntered;
Hover toolkitDraggingUpdated;

// `place`: how far the pointer is below the upper edge of the row.
void proposeDrop(id table, SEL selector, NSInteger row, NSInteger place, NSPoint point)
{
    const bool isLowerEdge = static_cast<CGFloat>(place) > [table rowHeight] * 3 / 4;
    if (isLowerEdge && row < [table numberOfRows])
        toolkitProposeDrop(table, selector, row + 1, 0, point);
    else
        toolkitProposeDrop(table, selector, row, place, point);
}

void takeMarkAway(NSView* table)
{
    [table setNeedsDisplay:YES];
    [table displayIfNeeded];
}

// All of it shows at once: no mark of a drop that is refused, and none of the place before.
NSDragOperation draggingUpdated(id table, SEL selector, id drag)
{
    NSWindow* window = [table window];
    [window disableFlushWindow];
    takeMarkAway(table);
    toolkitDraggingEntered(table, @selector(draggingEntered:), drag); // forgets what it has answered before
    const NSDragOperation operation = toolkitDraggingUpdated(table, selector, drag);
    if (operation == NSDragOperationNone)
        takeMarkAway(table);
    [window enableFlushWindow];
    [window flushWindow];
    return operation;
}

NSDragOperation draggingEntered(id table, SEL selector, id drag)
{
    return [table draggingUpdated:drag];
}
} // namespace

void showWhereDropsLandInTables()
{
    toolkitProposeDrop = standInFor(
        "NSTableView", @selector(_setDropOperationAndRow:usingPositionInRow:atPoint:), proposeDrop);
    toolkitDraggingUpdated = standInFor("NSTableView", @selector(draggingUpdated:), draggingUpdated);
    toolkitDraggingEntered = standInFor("NSTableView", @selector(draggingEntered:), draggingEntered);
}
} // namespace tessel::windowing
