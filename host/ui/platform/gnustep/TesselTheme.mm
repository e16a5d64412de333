#include "host/ui/platform/gnustep/TesselTheme.h"

#include "host/ui/platform/gnustep/ThemeButtons.h"
#include "host/ui/platform/gnustep/ThemeFocus.h"
#include "host/ui/platform/gnustep/ThemeShapes.h"

using namespace tessel::windowing;

namespace
{
bool isPressed(GSThemeControlState state)
{
    return state == GSThemeHighlightedState || state == GSThemeHighlightedFirstResponderState;
}

bool hasFocus(GSThemeControlState state)
{
    return state == GSThemeFirstResponderState || state == GSThemeHighlightedFirstResponderState ||
           state == GSThemeSelectedFirstResponderState;
}
} // namespace

NSColor* tessel::windowing::themeColor(NSString* name)
{
    return [[GSTheme theme] colorNamed:name state:GSThemeNormalState];
}

@implementation TesselTheme

- (void)drawButton:(NSRect)frame
                in:(NSCell*)cell
              view:(NSView*)view
             style:(int)style
             state:(GSThemeControlState)state
{
    ButtonLook look;
    look.pressed = isPressed(state);
    look.disabled = state == GSThemeDisabledState;
    look.isDefault = isDefaultButton(cell);
    look.hasFocus = hasFocus(state);
    drawButtonShape(style == NSRoundedBezelStyle ? NSInsetRect(frame, 1, 2) : NSInsetRect(frame, 1, 1), look);
}

// The toolkit would put the picture of a Return key into the default button, whose colour tells already.
- (void)setKeyEquivalent:(NSString*)key forButtonCell:(NSButtonCell*)cell
{
}

// A button with an edge has its ring there.
- (void)drawFocusFrame:(NSRect)frame view:(NSView*)view
{
    if ([view isKindOfClass:[NSButton class]] && [(NSButton*)view isBordered])
        return;
    drawFocusRing(NSInsetRect(frame, -1, -1));
}

// Of fields that are typed into; lists have a frame of their own.
- (void)drawBorderType:(NSBorderType)type frame:(NSRect)frame view:(NSView*)view
{
    [super drawBorderType:type frame:frame view:view];
    if (type == NSBezelBorder && hasKeyboard(view))
        drawFocusRing(frame);
}

- (NSRect)drawDarkBezel:(NSRect)border withClip:(NSRect)clip
{
    return drawBorder(border);
}

- (NSRect)drawGrayBezel:(NSRect)border withClip:(NSRect)clip
{
    return drawBorder(border);
}

- (NSRect)drawWhiteBezel:(NSRect)border withClip:(NSRect)clip
{
    return drawBorder(border);
}

- (NSRect)drawGroove:(NSRect)border withClip:(NSRect)clip
{
    return drawBorder(border);
}

@end
