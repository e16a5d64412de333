#include "modrig/dialogs/platform/Waiting.h"

#import <GNUstepGUI/GSDisplayServer.h>

#include <X11/Xlib.h>
#include <X11/cursorfont.h>

namespace ModrigPlatform
{
namespace
{
Display* display()
{
    return static_cast<Display*>([GSCurrentServer() serverDevice]);
}

Window deviceOf(NSWindow* window)
{
    return reinterpret_cast<Window>([GSCurrentServer() windowDevice:static_cast<int>([window windowNumber])]);
}

// Kept to the end: one for the session.
Cursor hourglass()
{
    static const Cursor cursor = XCreateFontCursor(display(), XC_watch);
    return cursor;
}
} // namespace

// The toolkit has no such cursor; the desktop has.
void ShowWaitCursor(NSWindow* window)
{
    if (!window)
        return;
    XDefineCursor(display(), deviceOf(window), hourglass());
    XFlush(display());
}

void EndWaitCursor(NSWindow* window)
{
    if (!window)
        return;
    XUndefineCursor(display(), deviceOf(window));
    [[NSCursor arrowCursor] set];
}

void DrawNow(NSWindow* window)
{
    [window displayIfNeeded];
    [window flushWindow];
    XFlush(display());
}
} // namespace ModrigPlatform
