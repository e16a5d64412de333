// The manners of the desktop that the dialogs run on.
#pragma once

#import <AppKit/AppKit.h>

namespace ModrigPlatform
{
// Whether the event was made with the key for commands, or with the one that moves things.
bool IsCommand(NSEvent* event);
bool IsAlternate(NSEvent* event);
// Whether it was made with the keys that, together with a number, lead to a tab of a file panel's view.
bool IsForTabs(NSEvent* event);

// The click as the toolkit's tables have to see it, for Shift to take a range of rows and the key for
// commands single ones.
NSEvent* ClickOnTable(NSEvent* event);

// Shows the file where it lies, in the program that the desktop has for folders.
void ShowInFolder(NSString* path);

// Whether the toolkit's tables shorten what does not fit into a cell.
bool TablesShortenTexts();
} // namespace ModrigPlatform
