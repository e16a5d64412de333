#include "host/ui/platform/gnustep/ThemeShapes.h"

namespace tessel::windowing
{
namespace
{
constexpr CGFloat kCorner = 5;
constexpr CGFloat kBorderWidth = 2;
constexpr CGFloat kKnobInset = 4;
constexpr CGFloat kTabMark = 2; // the line that marks the selected tab

NSColor* gray(CGFloat white)
{
    return [NSColor colorWithCalibratedRed:white - 0.012 green:white - 0.004 blue:white alpha:1];
}

NSColor* accent()
{
    return [NSColor colorWithCalibratedRed:0.184 green:0.435 blue:0.871 alpha:1];
}

NSColor* lineColor()
{
    return gray(0.78);
}

// A line drawn between pixels is two pixels wide and pale.
NSRect onPixels(NSRect rect)
{
    return NSInsetRect(NSIntegralRect(rect), 0.5, 0.5);
}

NSBezierPath* rounded(NSRect rect, CGFloat corner)
{
    return [NSBezierPath bezierPathWithRoundedRect:rect xRadius:corner yRadius:corner];
}

void drawRounded(NSRect rect, CGFloat corner, NSColor* fill, NSColor* line)
{
    NSBezierPath* path = rounded(onPixels(rect), corner);
    [fill set];
    [path fill];
    [line set];
    [path stroke];
}

void fill(NSRect rect, NSColor* color)
{
    [color set];
    NSRectFill(rect);
}

} // namespace

void drawButtonShape(NSRect shape, bool pressed, bool disabled)
{
    NSColor* face = pressed ? gray(0.86) : [NSColor whiteColor];
    drawRounded(shape, kCorner, disabled ? gray(0.95) : face, disabled ? gray(0.86) : lineColor());
}

void drawFocusRing(NSRect frame)
{
    NSBezierPath* ring = rounded(onPixels(frame), kCorner);
    [ring setLineWidth:2];
    [[accent() colorWithAlphaComponent:0.6] set];
    [ring stroke];
}

NSRect drawBorder(NSRect frame)
{
    [[NSColor controlBackgroundColor] set];
    NSFrameRectWithWidth(frame, kBorderWidth);
    [lineColor() set];
    NSFrameRect(frame);
    return NSInsetRect(frame, kBorderWidth, kBorderWidth);
}

void drawHeader(NSRect frame)
{
    fill(frame, gray(0.925));
    [lineColor() set];
    NSRectFill(NSMakeRect(NSMaxX(frame) - 1, NSMinY(frame) + 4, 1, NSHeight(frame) - 8));
    NSRectFill(NSMakeRect(NSMinX(frame), NSMaxY(frame) - 1, NSWidth(frame), 1));
}

NSRect tabPaneOf(NSRect bounds, bool flipped)
{
    bounds.size.height -= kTabHeight - 1;
    if (flipped)
        bounds.origin.y += kTabHeight - 1;
    return bounds;
}

void drawTabPane(NSRect pane)
{
    drawRounded(pane, kCorner, gray(0.975), lineColor());
}

void drawTab(NSRect tab, bool flipped)
{
    NSRect shape = tab;
    shape.size.height += kCorner; // its lower corners go under the pane
    if (!flipped)
        shape.origin.y -= kCorner;
    [NSGraphicsContext saveGraphicsState];
    NSRectClip(tab);
    drawRounded(shape, kCorner, gray(0.975), lineColor());
    [NSGraphicsContext restoreGraphicsState];
    const CGFloat top = flipped ? NSMinY(tab) : NSMaxY(tab) - kTabMark;
    fill(NSMakeRect(NSMinX(tab) + kCorner, top, NSWidth(tab) - 2 * kCorner, kTabMark), accent());
}

void drawScrollTrack(NSRect bounds, bool horizontal)
{
    fill(bounds, gray(0.965));
    fill(horizontal ? NSMakeRect(NSMinX(bounds), NSMaxY(bounds) - 1, NSWidth(bounds), 1)
                    : NSMakeRect(NSMinX(bounds), NSMinY(bounds), 1, NSHeight(bounds)),
         gray(0.88));
}

void drawScrollKnob(NSRect knob, bool horizontal)
{
    if (NSIsEmptyRect(knob))
        return;
    const NSRect shape = horizontal ? NSInsetRect(knob, 1, kKnobInset) : NSInsetRect(knob, kKnobInset, 1);
    [gray(0.73) set];
    [rounded(shape, 4) fill];
}
} // namespace tessel::windowing
