#import "modrig/dialogs/ModrigController.h"

#include <tesselui/tsuieach.h>

#import "modrig/dialogs/ModrigFilePath.h"
#import "modrig/dialogs/ModrigTableView.h"
#import "modrig/dialogs/TsOCModrigUtil.h"

#include "modrig/dialogs/Paths.h"
#include "modrig/dialogs/model/UnloadTip.h"
#include "modrig/dialogs/platform/Platform.h"
#include "modrig/lists/Globals.h"
#include "modrig/lists/ListRemoval.h"
#include "modrig/loader/LoadBatch.h"
#include "modrig/loader/LoadedApplications.h"

namespace
{
void addLoadedOf(const CStringList& list, NSMutableArray* paths)
{
    for (const CStdStr& path : list)
        if (ModrigUtils::ApplicationIsLoaded(path))
            [paths addObject:ModrigUtils::StringFromPath(path)];
}

std::vector<ModrigUtils::UnloadCandidate> unloadCandidates(NSArray* rows)
{
    std::vector<ModrigUtils::UnloadCandidate> candidates;
    for (ModrigFilePath* row : tsuiEach<ModrigFilePath*>(rows))
        candidates.push_back({[row path], static_cast<bool>([row unloadable])});
    return candidates;
}

// A header sends the action of its table too, and so does the empty part of some.
bool clickMissedTheRows(NSTableView* table)
{
    const NSEventType type = [[NSApp currentEvent] type];
    return (type == NSLeftMouseDown || type == NSLeftMouseUp) && [table clickedRow] < 0;
}

bool hasSelection(NSArrayController* rows)
{
    return [[rows selectedObjects] count] > 0;
}
} // namespace

@implementation ModrigController (Tables)

- (void)populateLoadedApplications
{
    NSMutableArray* paths = [NSMutableArray array];
    addLoadedOf(gLoadedAppList, paths);
    addLoadedOf(gStartupList, paths);
    [TsOCModrigUtil fill:loadedApps withPathNames:paths];
}

- (void)populateHistoryList
{
    [TsOCModrigUtil fill:historyList withPathNames:ModrigUtils::StringsFromList(gHistoryList)];
}

- (NSArrayController*)rowsOf:(NSTableView*)table
{
    if (table == loadedAppsTableView)
        return loadedApps;
    return table == historyListTableView ? historyList : nil;
}

- (ModrigUtils::TableKind)kindOfTable:(NSTableView*)table
{
    return table == loadedAppsTableView ? ModrigUtils::TableKind::kLoadedApplications
                                        : ModrigUtils::TableKind::kHistory;
}

- (void)perform:(ModrigUtils::TableAction)action inTable:(NSTableView*)table
{
    switch (action)
    {
    case ModrigUtils::TableAction::kLoad:
        return [self onLoadFromHistory:table];
    case ModrigUtils::TableAction::kAddToStartupSuite:
        return [self onAddToStartupSuiteFromHistory:table];
    case ModrigUtils::TableAction::kRemove:
        return [self onRemove:table];
    case ModrigUtils::TableAction::kUnload:
        return [self onUnload:table];
    default:
        return;
    }
}

// The Unload button's.
- (NSString*)tipOfButton:(NSButton*)button
{
    NSMutableArray* lines = [NSMutableArray array];
    for (const char* key :
         ModrigUtils::UnloadTip(canUnloadApp, [(ModrigTableView*)loadedAppsTableView states]))
        [lines addObject:[TsOCModrigUtil modrigLoadString:[NSString stringWithUTF8String:key]]];
    return [lines componentsJoinedByString:@"\n"];
}

- (NSInteger)numberOfRowsInTableView:(NSTableView*)table
{
    return static_cast<NSInteger>([[[self rowsOf:table] arrangedObjects] count]);
}

- (id)tableView:(NSTableView*)table objectValueForTableColumn:(NSTableColumn*)column row:(NSInteger)row
{
    return ModrigUtils::ValueInRow([self rowsOf:table], column, row);
}

- (void)tableViewSelectionDidChange:(NSNotification*)notification
{
    NSTableView* table = [notification object];
    ModrigPlatform::AdoptTableSelection(table, [self rowsOf:table]);
    if (table == loadedAppsTableView)
        [self keepToUnloadableRows];
    else if (table == historyListTableView)
        [self chooseFromHistory];
}

// Whoever selected the rows: Load loads what the History shows as selected.
- (void)chooseFromHistory
{
    self.canRemoveHistory = hasSelection(historyList);
    [mSelectedFiles setArray:[historyList selectedObjects]];
}

- (BOOL)historyIsChosen
{
    return [[historyList selectedObjects] indexOfObjectIdenticalTo:[mSelectedFiles lastObject]] != NSNotFound;
}

- (BOOL)tableView:(NSTableView*)table shouldSelectRow:(NSInteger)row
{
    if (table != loadedAppsTableView)
        return YES;
    NSArray* rows = [loadedApps arrangedObjects];
    if (row < 0 || static_cast<NSUInteger>(row) >= [rows count])
        return NO;
    return [[rows objectAtIndex:static_cast<NSUInteger>(row)] unloadable];
}

// The table is asked which rows may be selected when they are clicked, and not when new rows come selected.
- (void)keepToUnloadableRows
{
    NSMutableIndexSet* unloadable = [NSMutableIndexSet indexSet];
    NSIndexSet* selected = [loadedApps selectionIndexes];
    for (NSUInteger row = [selected firstIndex]; row != NSNotFound;
         row = [selected indexGreaterThanIndex:row])
        if ([self tableView:loadedAppsTableView shouldSelectRow:static_cast<NSInteger>(row)])
            [unloadable addIndex:row];
    [loadedApps setSelectionIndexes:unloadable];
    // The binding is silent while it is at work itself.
    [loadedAppsTableView selectRowIndexes:unloadable byExtendingSelection:NO];
    self.canUnloadApp = hasSelection(loadedApps);
}

- (void)tabView:(NSTabView*)tabView didSelectTabViewItem:(NSTabViewItem*)item
{
    [loadedAppsTableView sizeLastColumnToFit];
    [historyListTableView sizeLastColumnToFit];
    ModrigPlatform::UpdateKeyViews([tabView window]);
}

- (IBAction)onLoadFromHistory:(id)sender
{
    if (hasSelection(historyList))
        [self loadApps:[historyList selectedObjects] successedApps:nil addToStartupSuit:NO];
}

- (IBAction)onDoubleClickHistoryTableView:(id)sender
{
    if (sender == historyListTableView && !clickMissedTheRows(historyListTableView))
        [self onLoadFromHistory:sender];
}

- (IBAction)onAddToStartupSuiteFromHistory:(id)sender
{
    NSMutableArray* paths = [NSMutableArray array];
    for (ModrigFilePath* row : tsuiEach<ModrigFilePath*>([historyList selectedObjects]))
        [paths addObject:[row filePathName]];
    if ([paths count])
        [self dropFiles:paths atRow:ModrigUtils::kAppendRow addToStartupList:YES];
}

- (IBAction)onRemove:(id)sender
{
    NSArray* rows = [[[historyList selectedObjects] copy] autorelease];
    if ([rows count] == 0)
        return;
    [self clearMessage];
    ModrigUtils::RemoveFromHistory(ModrigUtils::PathsFromRows(rows),
                                   ModrigUtils::RemovingRows(rows, historyList));
}

- (IBAction)onUnload:(id)sender
{
    NSArray* rows = [[[loadedApps selectedObjects] copy] autorelease];
    if ([rows count] == 0)
        return;
    [self clearMessage];
    ModrigUtils::UnloadApplications(unloadCandidates(rows), ModrigUtils::RemovingRows(rows, loadedApps));
}

@end
