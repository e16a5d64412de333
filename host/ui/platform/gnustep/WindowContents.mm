// The window manager's frame is so many pixels wide, which the toolkit takes for points when it puts the
// inside of a window into it. At larger scales the inside stood too far up and to the right: its upper edge
// was cut, and at its lower edge and on its left there was a black line. The toolkit's own frame, where there
// is no window manager, is in points; there the inside may begin within a pixel.
#import <AppKit/AppKit.h>
#import <GNUstepGUI/GSWindowDecorationView.h>

#include <cmath>

#include "host/platform/gnustep/StandIn.h"
#include "host/ui/platform/gnustep/Behaviour.h"

@interface GSWindowDecorationView (WindowContents)
- (void)placeContentsAtPixel:(NSPoint)pixel;
- (NSPoint)placeOfContents;
@end

@implementation GSWindowDecorationView (WindowContents)

- (void)placeContentsAtPixel:(NSPoint)pixel
{
    const CGFloat scale = [window userSpaceScaleFactor];
    contentRect.origin = NSMakePoint(std::round(pixel.x) / scale, std::round(pixel.y) / scale);
    if ([[window contentView] superview] == self)
        [[window contentView] setFrameOrigin:contentRect.origin];
}

- (NSPoint)placeOfContents
{
    return contentRect.origin;
}

@end

namespace tessel::windowing
{
namespace
{
using LayOut = void (*)(id, SEL);
LayOut toolkitLayOutFramed;
LayOut toolkitLayOutFraming;

void layOutFramed(id view, SEL selector)
{
    toolkitLayOutFramed(view, selector);
    [view placeContentsAtPixel:[view placeOfContents]];
}

void layOutFraming(id view, SEL selector)
{
    toolkitLayOutFraming(view, selector);
    const NSPoint place = [view placeOfContents];
    const CGFloat scale = [[view window] userSpaceScaleFactor];
    [view placeContentsAtPixel:NSMakePoint(place.x * scale, place.y * scale)];
}
} // namespace

void placeContentsOfWindows()
{
    toolkitLayOutFramed = overrideIn("GSBackendWindowDecorationView", @selector(layout), layOutFramed);
    toolkitLayOutFraming = standInFor("GSStandardWindowDecorationView", @selector(layout), layOutFraming);
}
} // namespace tessel::windowing
