// The toolkit starts the title of a pop-up button at its very edge, and has an arrow of another kind for a
// list of actions than for a choice. Drawn here instead.
#include "host/platform/gnustep/StandIn.h"
#include "host/ui/platform/gnustep/Mnemonics.h"
#include "host/ui/platform/gnustep/ThemeButtons.h"

#import <AppKit/AppKit.h>

namespace tessel::windowing
{
namespace
{
constexpr CGFloat kArrowWidth = 12;
constexpr CGFloat kPadding = 8;

bool gIsComplete = false;

NSDictionary* lookOfTitle(NSCell* cell)
{
    NSMutableParagraphStyle* style = [[[NSMutableParagraphStyle alloc] init] autorelease];
    [style setLineBreakMode:NSLineBreakByTruncatingTail];
    NSColor* color = [cell isEnabled] ? [NSColor controlTextColor] : [NSColor disabledControlTextColor];
    return [NSDictionary dictionaryWithObjectsAndKeys:[cell font], NSFontAttributeName, color,
                                                      NSForegroundColorAttributeName, style,
                                                      NSParagraphStyleAttributeName, nil];
}

void drawTitle(NSAttributedString* title, NSRect frame)
{
    const CGFloat height = [title size].height;
    frame.origin.y = NSMidY(frame) - height / 2;
    frame.size.height = height;
    [title drawInRect:frame];
}

NSAttributedString* titleOf(NSCell* cell, NSString* text)
{
    return [[[NSAttributedString alloc] initWithString:text attributes:lookOfTitle(cell)] autorelease];
}

void drawArrow(NSRect frame, NSView* view)
{
    NSImage* arrow = [NSImage imageNamed:@"common_Nibble"];
    [arrow drawInRect:NSMakeRect(NSMaxX(frame) - kPadding - kArrowWidth, NSMidY(frame) - kArrowWidth / 2,
                                 kArrowWidth, kArrowWidth)
              fromRect:NSZeroRect
             operation:NSCompositeSourceOver
              fraction:1
        respectFlipped:[view isFlipped]
                 hints:nil];
}

void drawInterior(id cell, SEL, NSRect frame, NSView* view)
{
    NSRect inside = NSInsetRect(frame, kPadding, 0);
    inside.size.width -= kArrowWidth;
    if (NSString* text = [cell title])
        drawTitle(withMnemonic(titleOf(cell, text), view), inside);
    drawArrow(frame, view);
}
} // namespace

void completePopUps()
{
    if (!gIsComplete)
        standInFor("NSPopUpButtonCell", @selector(drawInteriorWithFrame:inView:), drawInterior);
    gIsComplete = true;
}
} // namespace tessel::windowing
