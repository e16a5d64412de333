// The toolkit asks its theme for the face of a segment without saying whether the segment is enabled, and
// writes every label in the same colour: a segment that answers no click looks like any other. Drawn here
// instead.
#include "host/ui/platform/gnustep/ThemeSegments.h"

#import <AppKit/AppKit.h>

#include "host/ui/platform/gnustep/StandIn.h"
#include "host/ui/platform/gnustep/ThemeShapes.h"

namespace tessel::windowing
{
namespace
{
using DrawSegment = void (*)(id, SEL, NSInteger, NSRect, NSView*);
DrawSegment toolkitDrawSegment;

// By drawing a segment the toolkit learns where clicks on it go, so it draws; nobody sees it.
void drawUnseen(id cell, SEL selector, NSInteger segment, NSRect frame, NSView* view)
{
    [NSGraphicsContext saveGraphicsState];
    NSRectClip(NSZeroRect);
    toolkitDrawSegment(cell, selector, segment, frame, view);
    [NSGraphicsContext restoreGraphicsState];
}

void drawLabel(NSString* label, NSFont* font, bool enabled, NSRect frame)
{
    NSColor* color = enabled ? [NSColor controlTextColor] : [NSColor disabledControlTextColor];
    NSDictionary* look = [NSDictionary
        dictionaryWithObjectsAndKeys:font, NSFontAttributeName, color, NSForegroundColorAttributeName, nil];
    const NSSize size = [label sizeWithAttributes:look];
    [label drawAtPoint:NSMakePoint(NSMidX(frame) - size.width / 2, NSMidY(frame) - size.height / 2)
        withAttributes:look];
}

void drawSegment(id cell, SEL selector, NSInteger segment, NSRect frame, NSView* view)
{
    drawUnseen(cell, selector, segment, frame, view);
    const bool enabled = [cell isEnabledForSegment:segment];
    drawButtonShape(NSInsetRect(frame, 1, 1), [cell isSelectedForSegment:segment], !enabled);
    if (NSString* label = [cell labelForSegment:segment])
        drawLabel(label, [cell font], enabled, frame);
}
} // namespace

void drawSegmentsAsButtons()
{
    if (!toolkitDrawSegment)
        toolkitDrawSegment =
            standInFor<DrawSegment>("NSSegmentedCell", @selector(drawSegment:inFrame:withView:), drawSegment);
}
} // namespace tessel::windowing
