// At a scale like 1.25 the edges of views lie within pixels. What the toolkit draws again of a window is then
// a little smaller or larger than the view that asked for it: the edge of the view is drawn over itself,
// darker each time, and by a rounding the view still seems to wait for its turn, so that it is drawn once
// more, over what stands there: letters look bold, and the frame of the focus stays. Here whole pixels are
// drawn again.
#import <AppKit/AppKit.h>

#include <cmath>

#include "host/platform/gnustep/StandIn.h"
#include "host/ui/platform/gnustep/Behaviour.h"

namespace tessel::windowing
{
namespace
{
constexpr CGFloat kRounding = 0.01; // of a pixel, which conversions between views may add or take

using DisplayRect = void (*)(id, SEL, NSRect);
DisplayRect toolkitDisplayRect;

NSRect wholePixels(NSRect pixels)
{
    const CGFloat left = std::floor(NSMinX(pixels) - kRounding);
    const CGFloat bottom = std::floor(NSMinY(pixels) - kRounding);
    return NSMakeRect(left, bottom, std::ceil(NSMaxX(pixels) + kRounding) - left,
                      std::ceil(NSMaxY(pixels) + kRounding) - bottom);
}

void displayRect(id view, SEL selector, NSRect rect)
{
    if (!NSIsEmptyRect(rect))
        rect = [view convertRect:wholePixels([view convertRect:rect toView:nil]) fromView:nil];
    toolkitDisplayRect(view, selector, rect);
}

using DisplayRectIn = void (*)(id, SEL, NSRect, NSGraphicsContext*);
DisplayRectIn toolkitDisplayRectIn;

// Called for a view and for those in it; no view draws beyond its edges.
void displayRectIn(id view, SEL selector, NSRect rect, NSGraphicsContext* context)
{
    if (!NSIsEmptyRect(rect))
        rect = NSInsetRect(rect, -kRounding, -kRounding);
    toolkitDisplayRectIn(view, selector, rect, context);
}

using OpaqueAncestor = NSView* (*)(id, SEL);
OpaqueAncestor toolkitOpaqueAncestor;

bool standsOnPixels(NSView* view)
{
    const NSRect pixels = [view convertRect:[view bounds] toView:nil];
    const NSRect whole = NSIntegralRect(NSInsetRect(pixels, kRounding, kRounding));
    return NSContainsRect(NSInsetRect(whole, -kRounding, -kRounding), pixels) &&
           NSContainsRect(NSInsetRect(pixels, -kRounding, -kRounding), whole);
}

// A view that fills its frame covers the pixels on its edges only in part: what is under it shows there.
NSView* opaqueAncestor(id view, SEL selector)
{
    NSView* opaque = toolkitOpaqueAncestor(view, selector);
    while ([view window] && [opaque superview] && !standsOnPixels(opaque))
        opaque = toolkitOpaqueAncestor([opaque superview], selector);
    return opaque;
}

using SetFrame = void (*)(id, SEL, NSRect, BOOL);
SetFrame toolkitSetWindowFrame;

// The screen has no half pixels to show at the edge of a window.
void setWindowFrame(id window, SEL selector, NSRect frame, BOOL display)
{
    toolkitSetWindowFrame(window, selector,
                          NSMakeRect(std::round(NSMinX(frame)), std::round(NSMinY(frame)),
                                     std::round(NSWidth(frame)), std::round(NSHeight(frame))),
                          display);
}
} // namespace

void drawWholePixels()
{
    toolkitSetWindowFrame = standInFor("NSWindow", @selector(setFrame:display:), setWindowFrame);
    toolkitOpaqueAncestor = standInFor("NSView", @selector(opaqueAncestor), opaqueAncestor);
    toolkitDisplayRectIn =
        standInFor("NSView", @selector(displayRectIgnoringOpacity:inContext:), displayRectIn);
    toolkitDisplayRect = standInFor("NSView", @selector(displayRectIgnoringOpacity:), displayRect);
}
} // namespace tessel::windowing
