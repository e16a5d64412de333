#include "modrig/dialogs/platform/Waiting.h"

namespace ModrigPlatform
{
// The system shows its own when a program does not answer.
void ShowWaitCursor(NSWindow*)
{
}

void EndWaitCursor(NSWindow*)
{
}

void DrawNow(NSWindow* window)
{
    [window displayIfNeeded];
}

bool TakeEscape()
{
    constexpr unichar kEscape = 0x1B;
    bool escape = false;
    while (NSEvent* event = [NSApp nextEventMatchingMask:NSKeyDownMask
                                               untilDate:[NSDate distantPast]
                                                  inMode:NSEventTrackingRunLoopMode
                                                 dequeue:YES])
        escape |= [[event characters] length] == 1 && [[event characters] characterAtIndex:0] == kEscape;
    return escape;
}
} // namespace ModrigPlatform
