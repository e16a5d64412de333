// The toolkit asks its theme for the face of a segment without saying whether the segment is enabled, and
// writes every label in the same colour: a segment that answers no click looks like any other. Drawn here
// instead. The titles of buttons are all of one colour as well, which cannot be read on the accent colour.
#include "host/ui/platform/gnustep/ThemeButtons.h"

#import <AppKit/AppKit.h>

#include "host/platform/gnustep/StandIn.h"
#include "host/ui/platform/gnustep/TesselTheme.h"
#include "host/ui/platform/gnustep/ThemeFocus.h"
#include "host/ui/platform/gnustep/ThemeShapes.h"

namespace tessel::windowing
{
namespace
{
using DrawSegment = void (*)(id, SEL, NSInteger, NSRect, NSView*);
DrawSegment toolkitDrawSegment;

using TextColor = NSColor* (*)(id, SEL);
TextColor toolkitTextColor;

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
    ButtonLook look;
    look.pressed = [cell isSelectedForSegment:segment];
    look.disabled = ![cell isEnabledForSegment:segment];
    drawButtonShape(NSInsetRect(frame, 1, 1), look);
    if (NSString* label = [cell labelForSegment:segment])
        drawLabel(label, [cell font], !look.disabled, frame);
}

// Its segments are its frame; another one around them would be a second.
void drawSegments(id cell, SEL, NSRect frame, NSView* view)
{
    [cell drawInteriorWithFrame:frame inView:view];
    if (hasKeyboard(view))
        drawFocusRing(NSInsetRect(frame, -1, -1));
}

NSColor* textColor(id cell, SEL selector)
{
    return isDefaultButton(cell) && [cell isEnabled] ? themeColor(@"accentTextColor")
                                                     : toolkitTextColor(cell, selector);
}
} // namespace

bool isDefaultButton(NSCell* cell)
{
    return [cell isKindOfClass:[NSButtonCell class]] && ![cell isKindOfClass:[NSMenuItemCell class]] &&
           [[(NSButtonCell*)cell keyEquivalent] isEqual:@"\r"];
}

void completeButtons()
{
    if (toolkitDrawSegment)
        return;
    toolkitDrawSegment = standInFor("NSSegmentedCell", @selector(drawSegment:inFrame:withView:), drawSegment);
    overrideIn("NSSegmentedCell", @selector(drawWithFrame:inView:), drawSegments);
    toolkitTextColor = standInFor("NSButtonCell", @selector(textColor), textColor);
}
} // namespace tessel::windowing
