#import "modrig/dialogs/ModrigController.h"

#include <tesselui/tsuieach.h>

#import "modrig/dialogs/ModrigFilePath.h"
#import "modrig/dialogs/TsOCModrigUtil.h"

#include "modrig/dialogs/Paths.h"
#include "modrig/loader/FileIntake.h"
#include "modrig/loader/LoadBatch.h"

namespace
{
NSArray* draggedPaths(id<NSDraggingInfo> info)
{
    return [[info draggingPasteboard] propertyListForType:NSFilenamesPboardType];
}

// A file without an extension gets message 2 when it is asked whether it can be loaded. During a drag that
// would be a box at every move of the mouse, which the program that the files come from holds, out of reach
// until the drop: what has no extension is passed over here, and heard of when it is dropped with others.
bool hasExtension(NSString* path)
{
    const NSRange dot = [path rangeOfString:@"." options:NSBackwardsSearch];
    return dot.location != NSNotFound && NSMaxRange(dot) < [path length];
}

// One file that can be loaded among those dragged is enough.
NSDragOperation operationFor(id<NSDraggingInfo> info)
{
    for (NSString* path : tsuiEach<NSString*>(draggedPaths(info)))
        if (hasExtension(path) && [TsOCModrigUtil isValidFileForModrig:path])
            return NSDragOperationCopy;
    return NSDragOperationNone;
}
} // namespace

@implementation ModrigController (DragAndDrop)

- (NSDragOperation)tableView:(NSTableView*)table
                validateDrop:(id<NSDraggingInfo>)info
                 proposedRow:(NSInteger)row
       proposedDropOperation:(NSTableViewDropOperation)operation
{
    // Below the rows a toolkit may propose the table as a whole, which is no row.
    const bool belowTheRows = row < 0 && table == loadedAppsTableView;
    if (operation == NSTableViewDropOn && !belowTheRows)
        return NSDragOperationNone;
    const NSDragOperation accepted = operationFor(info);
    if (belowTheRows && accepted != NSDragOperationNone)
        [table setDropRow:[table numberOfRows] dropOperation:NSTableViewDropAbove];
    return accepted;
}

// NO in any case: the rows appear as the files are loaded, and the table has nothing to show of its own.
- (BOOL)tableView:(NSTableView*)table
       acceptDrop:(id<NSDraggingInfo>)info
              row:(NSInteger)row
    dropOperation:(NSTableViewDropOperation)operation
{
    if (table == loadedAppsTableView)
        [self loadedAppsTableViewDropFiles:draggedPaths(info) atRow:row];
    else if (table == historyListTableView)
        [self historyTableViewDropFiles:draggedPaths(info) atRow:row];
    return NO;
}

- (void)loadedAppsTableViewDropFiles:(NSArray*)paths atRow:(NSInteger)row
{
    [self dropFiles:paths atRow:row addToStartupList:NO];
}

- (void)historyTableViewDropFiles:(NSArray*)paths atRow:(NSInteger)row
{
    mInsertRow = ModrigUtils::kAppendRow;
}

- (NSDragOperation)draggingEnteredStartupSuite:(id<NSDraggingInfo>)info
{
    return operationFor(info);
}

- (BOOL)performDragOperationToStartupSuite:(id<NSDraggingInfo>)info
{
    if ([[[info draggingPasteboard] types] containsObject:NSFilenamesPboardType])
        [self dropFiles:draggedPaths(info) atRow:ModrigUtils::kAppendRow addToStartupList:YES];
    return YES;
}

- (void)dropFiles:(NSArray*)paths atRow:(NSInteger)row addToStartupList:(BOOL)addToStartupList
{
    [self clearMessage];
    if (ModrigUtils::RefuseTooManyFiles([paths count]))
        return;
    NSArray* files =
        ModrigUtils::RowsFromPaths(ModrigUtils::AcceptedFiles(ModrigUtils::PathsFromStrings(paths)));
    if ([files count] == 0)
        return;
    NSMutableArray* loaded = addToStartupList ? [NSMutableArray array] : nil;
    mInsertRow = static_cast<int>(row);
    [self loadApps:files successedApps:loaded addToStartupSuit:addToStartupList];
    mInsertRow = ModrigUtils::kAppendRow;
    if (addToStartupList)
        ModrigUtils::AddToStartupSuite(ModrigUtils::PathsFromRows(loaded));
}

@end
