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
} // namespace ModrigPlatform
