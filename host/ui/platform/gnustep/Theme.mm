#include "host/ui/platform/gnustep/Theme.h"

#import <GNUstepGUI/GSTheme.h>

#include <tesselui/tsuieach.h>

#include "host/ui/platform/gnustep/ThemeSegments.h"
#include "host/ui/platform/gnustep/ThemeShapes.h"

using namespace tessel::windowing;

// The toolkit asks its theme to draw what it shows; what is not overridden here keeps the toolkit's look.
@interface TesselTheme : GSTheme
@end

@implementation TesselTheme

- (void)drawButton:(NSRect)frame
                in:(NSCell*)cell
              view:(NSView*)view
             style:(int)style
             state:(GSThemeControlState)state
{
    (void)cell;
    (void)view;
    const bool pressed = state == GSThemeHighlightedState || state == GSThemeHighlightedFirstResponderState ||
                         state == GSThemeSelectedState || state == GSThemeSelectedFirstResponderState;
    const NSRect shape = style == NSRoundedBezelStyle ? NSInsetRect(frame, 1, 2) : NSInsetRect(frame, 1, 1);
    drawButtonShape(shape, pressed, state == GSThemeDisabledState);
}

- (void)drawFocusFrame:(NSRect)frame view:(NSView*)view
{
    (void)view;
    drawFocusRing(NSInsetRect(frame, -1, -1));
}

- (NSRect)drawDarkBezel:(NSRect)border withClip:(NSRect)clip
{
    (void)clip;
    return drawBorder(border);
}

- (NSRect)drawGrayBezel:(NSRect)border withClip:(NSRect)clip
{
    (void)clip;
    return drawBorder(border);
}

- (NSRect)drawWhiteBezel:(NSRect)border withClip:(NSRect)clip
{
    (void)clip;
    return drawBorder(border);
}

- (NSRect)drawGroove:(NSRect)border withClip:(NSRect)clip
{
    (void)clip;
    return drawBorder(border);
}

- (void)drawTableHeaderCell:(NSTableHeaderCell*)cell
                  withFrame:(NSRect)frame
                     inView:(NSView*)view
                      state:(GSThemeControlState)state
{
    (void)cell;
    (void)view;
    (void)state;
    drawHeader(frame);
}

- (void)drawTableCornerView:(NSView*)view withClip:(NSRect)clip
{
    (void)clip;
    drawHeader([view bounds]);
}

- (void)drawBrowserHeaderCell:(NSTableHeaderCell*)cell withFrame:(NSRect)frame inView:(NSView*)view
{
    (void)cell;
    (void)view;
    drawHeader(frame);
}

- (void)drawTabViewRect:(NSRect)rect
                 inView:(NSView*)view
              withItems:(NSArray*)items
           selectedItem:(NSTabViewItem*)selected
{
    (void)rect;
    const NSRect bounds = [view bounds];
    const bool flipped = [view isFlipped];
    drawTabPane(tabPaneOf(bounds, flipped));
    NSRect tab = NSMakeRect(NSMinX(bounds) + kTabStart,
                            flipped ? NSMinY(bounds) : NSMaxY(bounds) - kTabHeight, 0, kTabHeight);
    for (NSTabViewItem* item : tsuiEach<NSTabViewItem*>(items))
    {
        tab.size.width = [item sizeOfLabel:NO].width + 2 * kTabPadding;
        [item _setTabState:item == selected ? NSSelectedTab : NSBackgroundTab];
        if (item == selected)
            drawTab(tab, flipped);
        [item drawLabel:NO inRect:NSInsetRect(tab, kTabPadding, 0)];
        tab.origin.x += tab.size.width;
    }
}

- (NSRect)tabViewContentRectForBounds:(NSRect)bounds tabViewType:(NSTabViewType)type tabView:(NSTabView*)view
{
    return type == NSTopTabsBezelBorder ? NSInsetRect(tabPaneOf(bounds, [view isFlipped]), 2, 2) : bounds;
}

- (void)drawScrollerRect:(NSRect)rect
                  inView:(NSView*)view
                 hitPart:(NSScrollerPart)part
            isHorizontal:(BOOL)horizontal
{
    (void)rect;
    (void)part;
    NSScroller* scroller = (NSScroller*)view;
    drawScrollTrack([view bounds], horizontal);
    if ([scroller isEnabled])
        drawScrollKnob([scroller rectForPart:NSScrollerKnob], horizontal);
}

@end

void tessel::windowing::useTheme(NSString* folder)
{
    NSBundle* bundle = folder ? [NSBundle bundleWithPath:folder] : nil;
    if (!bundle)
        return;
    GSTheme* theme = [[[TesselTheme alloc] initWithBundle:bundle] autorelease];
    [GSTheme setTheme:theme];
    drawSegmentsAsButtons();
    // Whenever a user default changes, the toolkit goes back to the theme that the defaults name.
    [[NSUserDefaults standardUserDefaults] registerDefaults:[NSDictionary dictionaryWithObject:[theme name]
                                                                                        forKey:@"GSTheme"]];
    NSString* icon = [bundle pathForResource:@"Tessel" ofType:@"png"];
    [NSApp setApplicationIconImage:[[[NSImage alloc] initWithContentsOfFile:icon] autorelease]];
}
