// A scroll view shows and hides its scrollers while it lays itself out, which changes the sizes that it has
// just decided by, and so decides again within itself. At a scale like 1.5 sizes are fractions, rounded in
// one way by the table and in another by the view around it: a table seems larger than its view by less than
// a thousandth of a pixel, gets a scroller, seems smaller by as much, loses it, and so on until the stack is
// used up. Here what does not fill half a pixel more is no larger, and nothing is decided within a decision.
#import <AppKit/AppKit.h>

#include "host/platform/gnustep/StandIn.h"
#include "host/ui/platform/gnustep/Behaviour.h"

namespace tessel::windowing
{
namespace
{
constexpr CGFloat kNoticed = 0.5;

using ReflectScrolling = void (*)(id, SEL, NSClipView*);
ReflectScrolling toolkitReflectScrolling;

void showScrollersNeeded(NSScrollView* scrollView, NSClipView* clip)
{
    if (![clip documentView])
        return;
    const bool tall = NSHeight([[clip documentView] frame]) > NSHeight([clip bounds]) + kNoticed;
    if (tall != [scrollView hasVerticalScroller])
        [scrollView setHasVerticalScroller:tall];
    // Asked only now: the one scroller takes from the room for the other.
    const bool wide = NSWidth([[clip documentView] frame]) > NSWidth([clip bounds]) + kNoticed;
    if (wide != [scrollView hasHorizontalScroller])
        [scrollView setHasHorizontalScroller:wide];
}

// The toolkit draws a knob, over the whole length, for a list that is larger by that little.
void restScroller(NSScroller* scroller, CGFloat content, CGFloat room)
{
    if (content <= room + kNoticed)
        [scroller setEnabled:NO];
}

void restScrollers(NSScrollView* scrollView, NSClipView* clip)
{
    const NSSize content = [[clip documentView] frame].size;
    const NSSize room = [clip bounds].size;
    restScroller([scrollView verticalScroller], content.height, room.height);
    restScroller([scrollView horizontalScroller], content.width, room.width);
}

void reflectScrolling(id scrollView, SEL selector, NSClipView* clip)
{
    const bool decides = [scrollView autohidesScrollers] && clip == [scrollView contentView];
    if (decides)
    {
        [scrollView setAutohidesScrollers:NO]; // also for what calls this again from within
        showScrollersNeeded(scrollView, clip);
    }
    toolkitReflectScrolling(scrollView, selector, clip);
    if (clip == [scrollView contentView])
        restScrollers(scrollView, clip);
    if (decides)
        [scrollView setAutohidesScrollers:YES];
}
} // namespace

void keepScrollersSteady()
{
    toolkitReflectScrolling =
        standInFor("NSScrollView", @selector(reflectScrolledClipView:), reflectScrolling);
}
} // namespace tessel::windowing
