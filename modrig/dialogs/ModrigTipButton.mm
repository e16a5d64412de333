#import "modrig/dialogs/ModrigTipButton.h"

@implementation ModrigTipButton

// The tip follows the button's place: this is called whenever that changes.
- (void)resetCursorRects
{
    [super resetCursorRects];
    [self removeAllToolTips];
    [self addToolTipRect:[self bounds] owner:self userData:nullptr];
}

- (NSString*)view:(NSView*)view stringForToolTip:(NSToolTipTag)tag point:(NSPoint)place userData:(void*)data
{
    return [[self target] tipOfButton:self];
}

@end
