// Tables, browsers and scrollers.
#include <algorithm>

#include "host/platform/gnustep/StandIn.h"
#include "host/ui/platform/gnustep/TesselTheme.h"
#include "host/ui/platform/gnustep/TextFitting.h"
#include "host/ui/platform/gnustep/ThemeFocus.h"
#include "host/ui/platform/gnustep/ThemeShapes.h"

using namespace tessel::windowing;

@implementation TesselTheme (Lists)

- (void)drawTableHeaderCell:(NSTableHeaderCell*)cell
                  withFrame:(NSRect)frame
                     inView:(NSView*)view
                      state:(GSThemeControlState)state
{
    drawHeader(frame);
}

// The cells cover the columns, and leave what lies beyond the last one.
- (void)drawTableHeaderRect:(NSRect)rect inView:(NSView*)view
{
    drawHeaderBackground([view bounds]);
    [super drawTableHeaderRect:rect inView:view];
}

- (void)drawTableCornerView:(NSView*)view withClip:(NSRect)clip
{
    drawHeaderBackground([view bounds]);
}

- (void)drawBrowserHeaderCell:(NSTableHeaderCell*)cell withFrame:(NSRect)frame inView:(NSView*)view
{
    drawHeader(frame);
}

// The frame of a list that the arrow keys move in.
- (void)drawScrollViewRect:(NSRect)rect inView:(NSView*)view
{
    [super drawScrollViewRect:rect inView:view];
    if (hasKeyboard(view))
        drawFocusRing([view bounds]);
}

- (void)drawScrollerRect:(NSRect)rect
                  inView:(NSView*)view
                 hitPart:(NSScrollerPart)part
            isHorizontal:(BOOL)horizontal
{
    NSScroller* scroller = (NSScroller*)view;
    drawScrollTrack([view bounds], horizontal);
    if ([scroller isEnabled])
        drawScrollKnob([scroller rectForPart:NSScrollerKnob], horizontal);
}

@end

namespace tessel::windowing
{
namespace
{
using CheckSpace = void (*)(id, SEL);
CheckSpace toolkitCheckSpace;

using SetFrameSize = void (*)(id, SEL, NSSize);
SetFrameSize toolkitSetFrameSize;

using DrawInterior = void (*)(id, SEL, NSRect, NSView*);
DrawInterior toolkitDrawHeaderTitle;

constexpr CGFloat kTitleMargin = 8; // what a header leaves free around its title

// A copy: a cell that gets another text asks to be drawn again.
void drawHeaderTitle(id header, SEL selector, NSRect frame, NSView* view)
{
    NSString* whole = [header stringValue];
    NSString* title = fitted(whole, [header font], NSWidth(frame) - kTitleMargin);
    NSCell* shown = title == whole ? header : [[header copy] autorelease];
    if (shown != header)
        [shown setStringValue:title];
    toolkitDrawHeaderTitle(shown, selector, frame, view);
}

// Asked whenever the size changes, from the first one on. The buttons would take clicks where nothing is
// drawn; a knob and its track are what people expect.
void checkSpace(id scroller, SEL selector)
{
    if ([scroller arrowsPosition] != NSScrollerArrowsNone)
        [scroller setArrowsPosition:NSScrollerArrowsNone];
    toolkitCheckSpace(scroller, selector);
}

// The toolkit makes the header as wide as the columns are when the table is read from its file.
void setHeaderSize(id header, SEL selector, NSSize size)
{
    if (NSView* place = [header superview])
        size.width = std::max(size.width, NSWidth([place bounds]));
    toolkitSetFrameSize(header, selector, size);
}

// Its place grows with the table; the header does so with its place.
void growWithPlace(id header, SEL, NSSize)
{
    [header setFrameSize:[header frame].size];
}
} // namespace

void completeTables()
{
    if (toolkitCheckSpace)
        return;
    toolkitCheckSpace = standInFor("NSScroller", @selector(checkSpaceForParts), checkSpace);
    toolkitSetFrameSize = overrideIn("NSTableHeaderView", @selector(setFrameSize:), setHeaderSize);
    overrideIn("NSTableHeaderView", @selector(resizeWithOldSuperviewSize:), growWithPlace);
    toolkitDrawHeaderTitle =
        overrideIn("NSTableHeaderCell", @selector(drawInteriorWithFrame:inView:), drawHeaderTitle);
}
} // namespace tessel::windowing
