// The list that a pop-up button opens, and menus.
#include "host/ui/platform/gnustep/TesselTheme.h"
#include "host/ui/platform/gnustep/ThemeShapes.h"

using namespace tessel::windowing;

@implementation TesselTheme (Menus)

- (void)drawBackgroundForMenuView:(NSMenuView*)menu
                        withFrame:(NSRect)bounds
                        dirtyRect:(NSRect)dirty
                       horizontal:(BOOL)horizontal
{
    drawMenuBackground(bounds);
}

// A frame around each item would make a stack of boxes of the list.
- (BOOL)drawsBorderForMenuItemCell:(NSMenuItemCell*)cell
                             state:(GSThemeControlState)state
                      isHorizontal:(BOOL)horizontal
{
    return NO;
}

- (void)drawBorderAndBackgroundForMenuItemCell:(NSMenuItemCell*)cell
                                     withFrame:(NSRect)frame
                                        inView:(NSView*)view
                                         state:(GSThemeControlState)state
                                  isHorizontal:(BOOL)horizontal
{
    if (state == GSThemeSelectedState || state == GSThemeHighlightedState)
        drawMenuSelection(frame);
}

@end
