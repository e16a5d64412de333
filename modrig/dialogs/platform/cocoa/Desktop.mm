#include "modrig/dialogs/platform/Desktop.h"

namespace ModrigPlatform
{
bool IsCommand(NSEvent* event)
{
    return [event modifierFlags] & NSCommandKeyMask;
}

bool IsAlternate(NSEvent* event)
{
    return [event modifierFlags] & NSAlternateKeyMask;
}

NSEvent* ClickOnTable(NSEvent* event)
{
    return event;
}

void ShowInFolder(NSString* path)
{
    [[NSWorkspace sharedWorkspace] selectFile:path inFileViewerRootedAtPath:@""];
}

bool TablesShortenTexts()
{
    return true;
}
} // namespace ModrigPlatform
