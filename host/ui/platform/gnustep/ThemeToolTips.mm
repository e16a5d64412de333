// The toolkit makes the window of a tool tip as wide as its text, wider than the screen too, and then wraps
// the text in something narrower: the last words are missing. Drawn here instead, with room around, and in
// several lines where one would be long to read.
#include <algorithm>
#include <cmath>

#include "host/platform/gnustep/StandIn.h"
#include "host/ui/platform/gnustep/TesselTheme.h"

namespace tessel::windowing
{
namespace
{
constexpr CGFloat kTipPadding = 6;
constexpr CGFloat kWidestText = 600;
constexpr CGFloat kWithoutEnd = 100000;

using SetText = void (*)(id, SEL, NSAttributedString*);
SetText toolkitSetText;

using SetFrame = void (*)(id, SEL, NSRect, BOOL);
SetFrame toolkitSetTipFrame;

NSDictionary* lookOfTips()
{
    return [NSDictionary dictionaryWithObjectsAndKeys:[NSFont toolTipsFontOfSize:0], NSFontAttributeName,
                                                      [NSColor controlTextColor],
                                                      NSForegroundColorAttributeName, nil];
}

void setText(id view, SEL selector, NSAttributedString* text)
{
    toolkitSetText(view, selector,
                   [[[NSAttributedString alloc] initWithString:[text string]
                                                    attributes:lookOfTips()] autorelease]);
}

// Never wider than the screen.
CGFloat widestText(id window)
{
    const CGFloat screen = NSWidth([[NSScreen mainScreen] frame]) / [window userSpaceScaleFactor];
    return std::min(kWidestText, screen - 2 * kTipPadding);
}

NSSize sizeOfText(NSAttributedString* text, CGFloat widest)
{
    const NSSize oneLine = [text size];
    if (oneLine.width <= widest)
        return oneLine;
    return [text boundingRectWithSize:NSMakeSize(widest, kWithoutEnd)
                              options:NSStringDrawingUsesLineFragmentOrigin]
        .size;
}

// The toolkit has measured the text without room around it, and in points: the window, which is measured in
// pixels, grows to the right and down, and stays on the screen.
void setTipFrame(id window, SEL selector, NSRect frame, BOOL display)
{
    const NSSize text = sizeOfText([[window contentView] valueForKey:@"text"], widestText(window));
    const NSRect screen = [[NSScreen mainScreen] frame];
    const CGFloat top = NSMaxY(frame);
    const CGFloat scale = [window userSpaceScaleFactor];
    frame.size = NSMakeSize((std::ceil(text.width) + 2 * kTipPadding) * scale,
                            (std::ceil(text.height) + kTipPadding) * scale);
    frame.origin.x = std::max(NSMinX(screen), std::min(NSMinX(frame), NSMaxX(screen) - NSWidth(frame)));
    frame.origin.y = std::max(NSMinY(screen), top - NSHeight(frame));
    toolkitSetTipFrame(window, selector, frame, display);
}

void drawTip(id view, SEL, NSRect)
{
    const NSRect bounds = [view bounds];
    [[NSColor toolTipColor] set];
    NSRectFill(bounds);
    [themeColor(@"lineColor") set];
    NSFrameRect(bounds);
    NSAttributedString* text = [view valueForKey:@"text"];
    // To the right the room is as wide as the lines may be: those that fit exactly are not broken again.
    [text drawInRect:NSMakeRect(NSMinX(bounds) + kTipPadding, NSMinY(bounds) + kTipPadding / 2,
                                widestText([view window]), NSHeight(bounds) - kTipPadding)];
}
} // namespace

void completeToolTips()
{
    if (toolkitSetText)
        return;
    toolkitSetText = standInFor("GSTTView", @selector(setText:), setText);
    standInFor("GSTTView", @selector(drawRect:), drawTip);
    toolkitSetTipFrame = overrideIn("GSTTPanel", @selector(setFrame:display:), setTipFrame);
}
} // namespace tessel::windowing
