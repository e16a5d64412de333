#import "modrig/dialogs/ModrigController.h"

#include <tesselui/tsuieach.h>

#import "modrig/dialogs/ModrigFilePath.h"
#import "modrig/dialogs/ModrigTableView.h"
#import "modrig/dialogs/TsOCModrigUtil.h"

#include "modrig/dialogs/Paths.h"
#include "modrig/dialogs/TableRows.h"
#include "modrig/dialogs/model/ChosenFiles.h"
#include "modrig/dialogs/model/RowInsertion.h"
#include "modrig/dialogs/model/RowSelection.h"
#include "modrig/dialogs/model/UnloadTip.h"
#include "modrig/dialogs/platform/Platform.h"
#include "modrig/lists/ListMembership.h"
#include "modrig/lists/ListRemoval.h"
#include "modrig/loader/LoadedApplications.h"

namespace
{
std::vector<ModrigUtils::UnloadCandidate> unloadCandidates(NSArray* rows)
{
    std::vector<ModrigUtils::UnloadCandidate> candidates;
    for (ModrigFilePath* row : tsuiEach<ModrigFilePath*>(rows))
        candidates.push_back({[row path], static_cast<bool>([row unloadable])});
    return candidates;
}

std::vector<ModrigUtils::RowIdentity> identitiesOf(NSArray* rows)
{
    std::vector<ModrigUtils::RowIdentity> identities;
    for (ModrigFilePath* row : tsuiEach<ModrigFilePath*>(rows))
        identities.push_back(row);
    return identities;
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
    ModrigUtils::FillTable(loadedApps, ModrigUtils::ApplicationsShownAsLoaded());
}

- (void)populateHistoryList
{
    ModrigUtils::FillTable(historyList, ModrigUtils::HistoryFiles());
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
    return ModrigUtils::AreChosenInHistory(identitiesOf(mSelectedFiles),
                                           identitiesOf([historyList selectedObjects]));
}

- (BOOL)tableView:(NSTableView*)table shouldSelectRow:(NSInteger)row
{
    NSArray* rows = [[self rowsOf:table] arrangedObjects];
    return ModrigUtils::MayBeSelected([self kindOfTable:table], row, [rows count],
                                      [=](std::size_t index) -> bool
                                      { return [[rows objectAtIndex:index] unloadable]; });
}

// The table is asked which rows may be selected when they are clicked, and not when new rows come selected.
- (void)keepToUnloadableRows
{
    NSTableView* table = loadedAppsTableView;
    const auto mayBeSelected = [=](std::size_t row) -> bool
    { return [self tableView:table shouldSelectRow:static_cast<NSInteger>(row)]; };
    NSIndexSet* staying = ModrigUtils::SetFromIndexes(
        ModrigUtils::SelectableOf(ModrigUtils::IndexesFromSet([loadedApps selectionIndexes]), mayBeSelected));
    [loadedApps setSelectionIndexes:staying];
    // While the binding hands the selection of the table over to the rows, it does not pass a change of
    // theirs back: the table is told here.
    [loadedAppsTableView selectRowIndexes:staying byExtendingSelection:NO];
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
    if (!hasSelection(historyList))
        return;
    [self clearMessage];
    ModrigUtils::RemoveFromHistory(ModrigUtils::TakeSelectedRows(historyList));
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
