#import "modrig/dialogs/ModrigController.h"

#import "modrig/dialogs/ModrigTableView.h"

#include "modrig/dialogs/Paths.h"
#include "modrig/dialogs/model/Drop.h"
#include "modrig/dialogs/model/RowInsertion.h"
#include "modrig/dialogs/platform/Dragging.h"
#include "modrig/lists/FileIntake.h"

namespace
{
NSArray* draggedPaths(id<NSDraggingInfo> info)
{
    return ModrigPlatform::PathsOn([info draggingPasteboard]);
}

ModrigUtils::DraggedFiles filesIn(NSArray* paths)
{
    return {[paths count],
            [=](std::size_t index) { return ModrigUtils::PathFromString([paths objectAtIndex:index]); }};
}
} // namespace

@implementation ModrigController (DragAndDrop)

- (NSDragOperation)tableView:(NSTableView*)table
                validateDrop:(id<NSDraggingInfo>)info
                 proposedRow:(NSInteger)row
       proposedDropOperation:(NSTableViewDropOperation)operation
{
    const ModrigUtils::ProposedDrop drop = {[(id)self kindOfTable:table], row,
                                            operation == NSTableViewDropOn};
    switch (ModrigUtils::AnswerDrop(drop, filesIn(draggedPaths(info))))
    {
    case ModrigUtils::DropAnswer::kRefused:
        return NSDragOperationNone;
    case ModrigUtils::DropAnswer::kTakenAtEnd:
        [table setDropRow:[table numberOfRows] dropOperation:NSTableViewDropAbove];
        return NSDragOperationCopy;
    case ModrigUtils::DropAnswer::kTaken:
        return NSDragOperationCopy;
    }
    return NSDragOperationNone;
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
    return ModrigUtils::HasApplication(filesIn(draggedPaths(info))) ? NSDragOperationCopy
                                                                    : NSDragOperationNone;
}

- (BOOL)performDragOperationToStartupSuite:(id<NSDraggingInfo>)info
{
    NSArray* types = [[info draggingPasteboard] types];
    if ([types firstObjectCommonWithArray:ModrigPlatform::DraggedFileTypes()])
        [self dropFiles:draggedPaths(info) atRow:ModrigUtils::kAppendRow addToStartupList:YES];
    return YES;
}

- (void)dropFiles:(NSArray*)paths atRow:(NSInteger)row addToStartupList:(BOOL)addToStartupList
{
    [self clearMessage];
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
