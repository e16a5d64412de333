#include "modrig/dialogs/platform/Desktop.h"

namespace ModrigPlatform
{
bool IsCommand(NSEvent* event)
{
    return [event modifierFlags] & NSEventModifierFlagCommand;
}

bool IsAlternate(NSEvent* event)
{
    return [event modifierFlags] & NSEventModifierFlagOption;
}

// Command alone with a number is the panel's: icons, list, columns.
bool IsForTabs(NSEvent* event)
{
    return IsCommand(event) && IsAlternate(event);
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
