// What a dialog looks like is remembered: where its window is, how large, and how wide its columns are.
#pragma once

#import <AppKit/AppKit.h>
#import <tesselui/TsUIPersistentStore.h>

namespace ModrigUtils
{
// The window opens where it was closed, as far as the screen allows; the first time where the system puts it.
void RestoreFrame(NSWindow* window, TsUIPersistentStore* settings, NSString* name);
void StoreFrame(NSWindow* window, TsUIPersistentStore* settings, NSString* name);

// The width of the table's first column; the last one fills the rest.
void RestoreColumns(NSTableView* table, TsUIPersistentStore* settings, NSString* name);
void StoreColumns(NSTableView* table, TsUIPersistentStore* settings, NSString* name);
} // namespace ModrigUtils
