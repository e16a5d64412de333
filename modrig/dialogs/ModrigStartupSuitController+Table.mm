// The rows of the Startup Suite: what their keys and their menu do, and how they look.
#import "modrig/dialogs/ModrigStartupSuitController.h"

#import "modrig/dialogs/ModrigFilePath.h"
#import "modrig/dialogs/ModrigTableView.h"

#include "modrig/dialogs/Paths.h"
#include "modrig/lists/StartupOrder.h"

@implementation ModrigStartupSuitController (Table)

- (ModrigUtils::TableKind)kindOfTable:(NSTableView*)table
{
    return ModrigUtils::TableKind::kStartupSuite;
}

- (NSArrayController*)rowsOf:(NSTableView*)table
{
    return startupApps;
}

- (BOOL)tableView:(NSTableView*)table shouldSelectRow:(NSInteger)row
{
    return YES;
}

- (BOOL)moveRow:(ModrigUtils::RowMove)move
{
    NSArray* rows = [startupApps arrangedObjects];
    ModrigFilePath* row = [[[rows objectAtIndex:move.from] retain] autorelease];
    ModrigFilePath* neighbour = [rows objectAtIndex:move.to];
    if (!ModrigUtils::MoveInStartupSuite([row path], [neighbour path]))
        return NO;
    [startupApps removeObjectAtArrangedObjectIndex:move.from];
    [startupApps insertObject:row atArrangedObjectIndex:move.to];
    return YES;
}

// The rows stay selected where they come to be.
- (void)moveSelectionUp:(BOOL)up
{
    NSMutableIndexSet* places = [NSMutableIndexSet indexSet];
    const auto moves = ModrigUtils::MovesOf(ModrigUtils::IndexesFromSet([startupApps selectionIndexes]),
                                            [[startupApps arrangedObjects] count], up);
    for (const ModrigUtils::RowMove& move : moves)
        [places addIndex:[self moveRow:move] ? move.to : move.from];
    if ([places count] == 0)
        return NSBeep();
    [startupTableView selectRowIndexes:places byExtendingSelection:NO];
    [startupTableView
        scrollRowToVisible:static_cast<NSInteger>(up ? [places firstIndex] : [places lastIndex])];
}

- (void)perform:(ModrigUtils::TableAction)action inTable:(NSTableView*)table
{
    switch (action)
    {
    case ModrigUtils::TableAction::kAdd:
        return [self onAdd];
    case ModrigUtils::TableAction::kRemove:
        return [self onRemove];
    case ModrigUtils::TableAction::kMoveUp:
        return [self moveSelectionUp:YES];
    case ModrigUtils::TableAction::kMoveDown:
        return [self moveSelectionUp:NO];
    default:
        return;
    }
}

@end
