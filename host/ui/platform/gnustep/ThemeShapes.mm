#include "host/ui/platform/gnustep/ThemeShapes.h"

#include <algorithm>
#include <cmath>

#include "host/ui/platform/gnustep/TesselTheme.h"

namespace tessel::windowing
{
namespace
{
constexpr CGFloat kCorner = 5;
constexpr CGFloat kBorderWidth = 2;
constexpr CGFloat kFocusWidth = 2;
constexpr CGFloat kKnobInset = 4;
constexpr CGFloat kKnobCorner = 4;
constexpr CGFloat kTabMark = 2; // the line that marks the selected tab
constexpr CGFloat kMenuInset = 2;

NSColor* lineColor()
{
    return themeColor(@"lineColor");
}

// A line is so many whole pixels wide, at a scale of one and a half as well.
CGFloat lineWidth()
{
    const CGFloat scale = [[[NSView focusView] window] userSpaceScaleFactor];
    return std::max<CGFloat>(1, std::round(scale)) / scale;
}

// The rectangle whose outline is a line along the inner edge of this one: a line drawn between pixels is
// wider and pale, and one beyond the edge is cut.
NSRect onPixels(NSRect rect)
{
    constexpr CGFloat kRounding = 0.01;
    NSView* view = [NSView focusView];
    const NSRect pixels = [view convertRect:rect toView:nil];
    const CGFloat left = std::ceil(NSMinX(pixels) - kRounding);
    const CGFloat bottom = std::ceil(NSMinY(pixels) - kRounding);
    const NSRect whole = NSMakeRect(left, bottom, std::floor(NSMaxX(pixels) + kRounding) - left,
                                    std::floor(NSMaxY(pixels) + kRounding) - bottom);
    return NSInsetRect([view convertRect:whole fromView:nil], lineWidth() / 2, lineWidth() / 2);
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
    [path setLineWidth:lineWidth()];
    [path stroke];
}

void fill(NSRect rect, NSColor* color)
{
    [color set];
    NSRectFill(rect);
}

NSString* faceOf(ButtonLook look)
{
    if (look.disabled)
        return @"disabledButtonColor";
    if (look.isDefault)
        return look.pressed ? @"pressedDefaultButtonColor" : @"accentColor";
    return look.pressed ? @"pressedButtonColor" : @"buttonColor";
}

NSString* edgeOf(ButtonLook look)
{
    if (look.disabled)
        return @"faintLineColor";
    return look.isDefault ? @"pressedDefaultButtonColor" : @"lineColor";
}
} // namespace

namespace
{
void drawRing(NSRect ring, CGFloat corner, NSColor* color)
{
    NSBezierPath* path = rounded(ring, corner);
    [path setLineWidth:kFocusWidth];
    [color set];
    [path stroke];
}
} // namespace

void drawFocusRing(NSRect frame)
{
    drawRing(NSInsetRect(frame, 1, 1), kCorner, [NSColor keyboardFocusIndicatorColor]);
}

void drawButtonShape(NSRect shape, ButtonLook look)
{
    drawRounded(shape, kCorner, themeColor(faceOf(look)), themeColor(edgeOf(look)));
    if (look.hasFocus && look.isDefault)
        drawRing(NSInsetRect(shape, 3, 3), kCorner - 2, themeColor(@"accentTextColor"));
    else if (look.hasFocus)
        drawFocusRing(shape);
}

NSRect drawBorder(NSRect frame)
{
    fill(frame, [NSColor controlBackgroundColor]);
    NSBezierPath* line = [NSBezierPath bezierPathWithRect:onPixels(frame)];
    [line setLineWidth:lineWidth()];
    [lineColor() set];
    [line stroke];
    return NSInsetRect(frame, kBorderWidth, kBorderWidth);
}

void drawHeaderBackground(NSRect frame)
{
    fill(frame, [NSColor headerColor]);
    fill(NSMakeRect(NSMinX(frame), NSMaxY(frame) - 1, NSWidth(frame), 1), lineColor());
}

void drawHeader(NSRect frame)
{
    drawHeaderBackground(frame);
    fill(NSMakeRect(NSMaxX(frame) - 1, NSMinY(frame) + 4, 1, NSHeight(frame) - 8), lineColor());
}

void drawPane(NSRect pane)
{
    drawRounded(pane, kCorner, themeColor(@"paneColor"), lineColor());
}

// Half of it stands above the pane, the other half in it.
void drawTitlePlate(NSRect frame)
{
    fill(frame, [NSColor windowBackgroundColor]);
}

NSRect tabPaneOf(NSRect bounds, bool flipped)
{
    bounds.size.height -= kTabHeight - 1;
    if (flipped)
        bounds.origin.y += kTabHeight - 1;
    return bounds;
}

void drawTab(NSRect tab, bool flipped)
{
    NSRect shape = tab;
    shape.size.height += kCorner; // its lower corners go under the pane
    if (!flipped)
        shape.origin.y -= kCorner;
    [NSGraphicsContext saveGraphicsState];
    NSRectClip(tab);
    drawPane(shape);
    [NSGraphicsContext restoreGraphicsState];
    const CGFloat top = flipped ? NSMinY(tab) : NSMaxY(tab) - kTabMark;
    fill(NSMakeRect(NSMinX(tab) + kCorner, top, NSWidth(tab) - 2 * kCorner, kTabMark),
         themeColor(@"accentColor"));
}

void drawScrollTrack(NSRect bounds, bool horizontal)
{
    fill(bounds, themeColor(@"scrollTrackColor"));
    fill(horizontal ? NSMakeRect(NSMinX(bounds), NSMaxY(bounds) - 1, NSWidth(bounds), 1)
                    : NSMakeRect(NSMinX(bounds), NSMinY(bounds), 1, NSHeight(bounds)),
         themeColor(@"faintLineColor"));
}

void drawScrollKnob(NSRect knob, bool horizontal)
{
    if (NSIsEmptyRect(knob))
        return;
    const NSRect shape = horizontal ? NSInsetRect(knob, kBorderWidth, kKnobInset)
                                    : NSInsetRect(knob, kKnobInset, kBorderWidth);
    [themeColor(@"scrollKnobColor") set];
    [rounded(shape, kKnobCorner) fill];
}

void drawMenuBackground(NSRect frame)
{
    fill(frame, [NSColor controlBackgroundColor]);
    [lineColor() set];
    NSFrameRect(frame);
}

void drawMenuSelection(NSRect frame)
{
    [[NSColor selectedMenuItemColor] set];
    [rounded(NSInsetRect(frame, kMenuInset, 0), kKnobCorner) fill];
}
} // namespace tessel::windowing
