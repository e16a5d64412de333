// A window while its program is busy and cannot look after it.
#pragma once

#import <AppKit/AppKit.h>

namespace ModrigPlatform
{
// The cursor over the window, at once: an hourglass, and what it is otherwise.
void ShowWaitCursor(NSWindow* window);
void EndWaitCursor(NSWindow* window);

// Draws at once what has changed in the window.
void DrawNow(NSWindow* window);
} // namespace ModrigPlatform
