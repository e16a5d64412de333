#include "tests/dialogs/support/Pictures.h"

NSData* pictureOf(NSView* view)
{
    [view lockFocus];
    NSBitmapImageRep* picture =
        [[[NSBitmapImageRep alloc] initWithFocusedViewRect:[view bounds]] autorelease];
    [view unlockFocus];
    return [picture TIFFRepresentation];
}
