#include "tests/dialogs/support/Pictures.h"

NSData* pictureOf(NSView* view, NSRect part)
{
    [view lockFocus];
    NSBitmapImageRep* picture = [[[NSBitmapImageRep alloc] initWithFocusedViewRect:part] autorelease];
    [view unlockFocus];
    return [picture TIFFRepresentation];
}

NSData* pictureOf(NSView* view)
{
    return pictureOf(view, [view bounds]);
}
