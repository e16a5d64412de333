// What the dialogs do differently on the toolkits they run on.
#pragma once

#import <AppKit/AppKit.h>

#include <optional>

namespace ModrigPlatform
{
// Makes the panel's accessory view as wide as the panel, at any size of it.
void FitAccessoryView(NSView* view);

// Puts the view into the panel, in sight.
void ShowAccessoryView(NSOpenPanel* panel, NSView* view);

// Sends the panel into the folder. It may get there later.
void ShowFolder(NSOpenPanel* panel, NSString* folder);
// The folder that the panel shows, or is on its way to. `known` (or nil): where it was sent or was last.
NSURL* FolderOf(NSOpenPanel* panel, NSString* known);

// Lets Tab walk through everything that the window shows now.
void UpdateKeyViews(NSWindow* window);

enum class FileKind
{
    kFile,
    kFolder
};

// What stands at the path, links followed; none when nothing does.
[[nodiscard]] std::optional<FileKind> FileKindAt(NSString* path);
// Whether its user sees the folder as one file.
bool IsFilePackage(NSString* path);

// Makes the table show the rows. Its columns are bound to them, and have the keys of what they show for
// identifiers; its data source answers both questions of a table, for toolkits where bindings are slow.
void ShowRows(NSTableView* table, NSArrayController* rows);

// Makes the rows that the user selected in the table those that the controller has selected.
void AdoptTableSelection(NSTableView* table, NSArrayController* rows);

// What the window file could not give the Add and Remove buttons.
void CompleteSegments(NSSegmentedControl* segments);
// The segment that was clicked, or -1. It is no longer pressed afterwards.
NSInteger TakeSegmentClick(NSSegmentedControl* segments);
} // namespace ModrigPlatform
