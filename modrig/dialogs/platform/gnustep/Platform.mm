#import "modrig/dialogs/ModrigArrayController.h"
#import "modrig/dialogs/NSSavePanel+ModrigRuntime.h"

#include <tesselui/tsuieach.h>
#include <tesselui/tsuifilepanel.h>

#include <sys/stat.h>

#include "modrig/dialogs/platform/Platform.h"

// The host's own panel, whose buttons have tags.
@implementation NSSavePanel (ModrigRuntime)

- (NSButton*)okButton
{
    return [[self contentView] viewWithTag:kTsUIFilePanelDefaultButton];
}

- (NSButton*)cancelButton
{
    return [[self contentView] viewWithTag:kTsUIFilePanelCancelButton];
}

- (NSButton*)hideExtensionButton
{
    return [[self contentView] viewWithTag:kTsUIFilePanelSpareButton];
}

@end

namespace ModrigPlatform
{
// The panel has placed the view among its own parts already; there is no frame around it to fill.
void FitAccessoryView(NSView* view)
{
    [view setAutoresizingMask:[view autoresizingMask] | NSViewWidthSizable];
}

void ShowAccessoryView(NSOpenPanel* panel, NSView* view)
{
    [panel setAccessoryView:view];
}

void ShowFolder(NSOpenPanel* panel, NSString* folder)
{
    [panel setDirectory:folder];
}

// It is there at once, and nobody tells where it goes.
NSURL* FolderOf(NSOpenPanel* panel, NSString*)
{
    return [panel directoryURL];
}

// The toolkit works it out once, and not again when another tab shows.
void UpdateKeyViews(NSWindow* window)
{
    [window recalculateKeyViewLoop];
}

std::optional<FileKind> FileKindAt(NSString* path)
{
    struct stat status;
    if (stat([path fileSystemRepresentation], &status) != 0)
        return std::nullopt;
    return S_ISDIR(status.st_mode) ? FileKind::kFolder : FileKind::kFile;
}

bool IsFilePackage(NSString* path)
{
    return [[NSWorkspace sharedWorkspace] isFilePackageAtPath:path];
}

// A bound column watches every row, and fetches what all of them show again for each cell that it draws. Here
// the table asks its data source for what it draws, and for nothing else.
void ShowRows(NSTableView* table, NSArrayController* rows)
{
    for (NSTableColumn* column : tsuiEach<NSTableColumn*>([table tableColumns]))
        [column unbind:NSValueBinding];
    [(ModrigArrayController*)rows setTable:table];
    [table reloadData];
}

// A selection made in the table does not reach the controller: bindings lead the other way only.
void AdoptTableSelection(NSTableView* table, NSArrayController* rows)
{
    [rows setSelectionIndexes:[table selectedRowIndexes]];
}

// The toolkit does not read the labels from the window file.
void CompleteSegments(NSSegmentedControl* segments)
{
    [segments setLabel:@"+" forSegment:0];
    [segments setLabel:@"\u2212" forSegment:1];
}

// A click on a disabled segment repeats the last one unless that has been taken back.
NSInteger TakeSegmentClick(NSSegmentedControl* segments)
{
    const NSInteger clicked = [segments selectedSegment];
    if (clicked >= 0)
        [segments setSelected:NO forSegment:clicked];
    return clicked;
}
} // namespace ModrigPlatform
