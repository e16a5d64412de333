// Tab views, and boxes around controls: both are panes of one kind.
#include <tesselui/tsuieach.h>

#include "host/ui/platform/gnustep/Mnemonics.h"
#include "host/ui/platform/gnustep/TesselTheme.h"
#include "host/ui/platform/gnustep/ThemeFocus.h"
#include "host/ui/platform/gnustep/ThemeShapes.h"

using namespace tessel::windowing;

namespace
{
// By drawing a label the toolkit learns where clicks on it go, so it draws; nobody sees it.
void drawUnseen(NSTabViewItem* item, NSRect tab)
{
    [NSGraphicsContext saveGraphicsState];
    NSRectClip(NSZeroRect);
    [item drawLabel:NO inRect:tab];
    [NSGraphicsContext restoreGraphicsState];
}

void drawLabel(NSTabViewItem* item, NSFont* font, NSRect tab)
{
    NSDictionary* look =
        [NSDictionary dictionaryWithObjectsAndKeys:font, NSFontAttributeName, [NSColor controlTextColor],
                                                   NSForegroundColorAttributeName, nil];
    NSAttributedString* label = labelOfTab(item, look);
    const NSSize size = [label size];
    [label drawAtPoint:NSMakePoint(NSMinX(tab) + kTabPadding, NSMidY(tab) - size.height / 2)];
}
} // namespace

@implementation TesselTheme (Boxes)

- (void)drawTabViewRect:(NSRect)rect
                 inView:(NSView*)view
              withItems:(NSArray*)items
           selectedItem:(NSTabViewItem*)selected
{
    const NSRect bounds = [view bounds];
    const bool flipped = [view isFlipped];
    drawPane(tabPaneOf(bounds, flipped));
    NSRect tab = NSMakeRect(NSMinX(bounds) + kTabStart,
                            flipped ? NSMinY(bounds) : NSMaxY(bounds) - kTabHeight, 0, kTabHeight);
    for (NSTabViewItem* item : tsuiEach<NSTabViewItem*>(items))
    {
        tab.size.width = [item sizeOfLabel:NO].width + 2 * kTabPadding;
        [item _setTabState:item == selected ? NSSelectedTab : NSBackgroundTab];
        if (item == selected)
            drawTab(tab, flipped);
        drawUnseen(item, NSInsetRect(tab, kTabPadding, 0));
        drawLabel(item, [(NSTabView*)view font], tab);
        if (item == selected && hasKeyboard(view))
            drawFocusRing(NSInsetRect(tab, 4, 4));
        tab.origin.x += tab.size.width;
    }
}

- (NSRect)tabViewContentRectForBounds:(NSRect)bounds tabViewType:(NSTabViewType)type tabView:(NSTabView*)view
{
    return type == NSTopTabsBezelBorder ? NSInsetRect(tabPaneOf(bounds, [view isFlipped]), 2, 2) : bounds;
}

// Its title stands on its upper edge.
- (void)drawBoxInClipRect:(NSRect)clip
                  boxType:(NSBoxType)type
               borderType:(NSBorderType)border
                   inView:(NSBox*)box
{
    if (type != NSBoxPrimary || border == NSNoBorder || [box titlePosition] != NSAtTop)
        return [super drawBoxInClipRect:clip boxType:type borderType:border inView:box];
    drawPane([box borderRect]);
    const NSRect title = [box titleRect];
    if ([[box title] length])
        drawTitlePlate(NSInsetRect(title, -kTitlePadding, 0));
    [[box titleCell] drawWithFrame:title inView:box];
}

@end
