#import "modrig/dialogs/ModrigController.h"

#include <tesselui/tsuieach.h>
#include <tesselui/tsuifilepanel.h>

#import "modrig/dialogs/ModrigArrayController.h"
#import "modrig/dialogs/ModrigFilePath.h"
#import "modrig/dialogs/ModrigStartupSuitController.h"
#import "modrig/dialogs/TsOCModrigUtil.h"

#include "modrig/dialogs/LongLoad.h"
#include "modrig/dialogs/Paths.h"
#include "modrig/dialogs/Settings.h"
#include "modrig/dialogs/model/ChosenFiles.h"
#include "modrig/dialogs/model/LoadSteps.h"
#include "modrig/dialogs/model/RowInsertion.h"
#include "modrig/dialogs/model/ShownTab.h"
#include "modrig/dialogs/platform/Platform.h"
#include "modrig/loader/LoadBatch.h"
#include "modrig/messages/Messages.h"

namespace
{
void insertRow(ModrigFilePath* row, NSArrayController* table, int insertRow)
{
    const NSUInteger count = [[table arrangedObjects] count];
    [table insertObject:row atArrangedObjectIndex:ModrigUtils::RowForInsertion(insertRow, count)];
}

void scrollToLastRow(NSTableView* table, NSArrayController* rows)
{
    const NSUInteger count = [[rows arrangedObjects] count];
    if (count > 0)
        [table scrollRowToVisible:static_cast<NSInteger>(count - 1)];
}
} // namespace

@implementation ModrigController (Loading)

// Removing rows from the History, say, leaves nothing chosen while the panel still shows its files as
// selected.
- (void)chooseWhatIsStillSelected
{
    const bool panelHasSelection = [self isAnyFileIn:[mOpenPanel URLs]];
    const bool historyHasSelection = [[historyList selectedObjects] count] > 0;
    switch (ModrigUtils::SourceWithoutChoice(panelHasSelection, historyHasSelection))
    {
    case ModrigUtils::LoadSource::kPanel:
        return [self panelSelectionDidChange:mOpenPanel];
    case ModrigUtils::LoadSource::kHistory:
        return [self chooseFromHistory];
    case ModrigUtils::LoadSource::kNothing:
        NSBeep();
        self.message = [TsOCModrigUtil modrigLoadString:@"IDS_MODRIG_NOTHING_CHOSEN"];
        return;
    }
}

- (void)rememberFolder
{
    [[self uiPersistentStore] putControlString:kSettingsGroup
                                       control:kInitialPathSetting
                                         value:[ModrigPlatform::FolderOf(mOpenPanel, self.shownFolder) path]];
}

- (IBAction)onLoad:(id)sender
{
    NSOpenPanel* panel = mOpenPanel;
    ModrigUtils::LoadSteps steps;
    steps.hasChosenFiles = [=] { return [[self chosenFiles] count] > 0; };
    steps.tellsOfMissingFile = [=] { return static_cast<bool>(tsuiTellOfMissingFile(panel)); };
    steps.chooseWhatIsStillSelected = [=] { [self chooseWhatIsStillSelected]; };
    steps.goesIntoHostFolder = [=] { return static_cast<bool>([self openTesselFolder]); };
    steps.loadChosenFiles = [=] { [self loadApps:[self chosenFiles] successedApps:nil addToStartupSuit:NO]; };
    steps.rememberFolder = [=] { [self rememberFolder]; };
    ModrigUtils::PressLoad(steps);
}

- (IBAction)onStartupSuits:(id)sender
{
    NSAutoreleasePool* pool = [[NSAutoreleasePool alloc] init];
    ModrigStartupSuitController* suite = [[ModrigStartupSuitController alloc] init];
    [suite showModalWindowCenterOfParent:[[self view] window]];
    [suite release];
    [pool drain];
}

- (IBAction)onHelp:(id)sender
{
    ModrigUtils::OnCommandHelp(ModrigUtils::kMainDialogHelp);
}

- (ModrigArrayController*)rowsOfKind:(ModrigUtils::TableKind)kind
{
    return (ModrigArrayController*)(kind == ModrigUtils::TableKind::kHistory ? historyList : loadedApps);
}

- (void)addRow:(ModrigFilePath*)row toTable:(ModrigUtils::TableKind)kind
{
    insertRow(row, [self rowsOfKind:kind], mInsertRow);
    if (kind == ModrigUtils::TableKind::kHistory)
        [self chooseFromHistory]; // new rows come selected, and not every toolkit tells of that
    else
        [self keepToUnloadableRows]; // a row in the place of the selected one is no change of the selection
}

- (void)addRowsFor:(NSString*)path
{
    // Thousands of files may be loaded in one go.
    NSAutoreleasePool* pool = [[NSAutoreleasePool alloc] init];
    ModrigFilePath* row = [[[ModrigFilePath alloc] initWithFilePathName:path] autorelease];
    const auto tables = ModrigUtils::TablesToJoin(mbSaveHistory,
                                                  [=](ModrigUtils::TableKind kind) -> bool
                                                  { return [[self rowsOfKind:kind] holds:row]; });
    for (const ModrigUtils::TableKind kind : tables)
        [self addRow:row toTable:kind];
    [pool drain];
}

- (void)showLastRowAfter:(unsigned)added
{
    const auto kind = ModrigUtils::TableToScroll(added, mInsertRow, tabViewSelectedIndex);
    if (kind == ModrigUtils::TableKind::kLoadedApplications)
        scrollToLastRow(loadedAppsTableView, loadedApps);
    else if (kind == ModrigUtils::TableKind::kHistory)
        scrollToLastRow(historyListTableView, historyList);
}

- (std::vector<ModrigUtils::BatchFile>)batchFilesOf:(NSArray*)rows
{
    std::vector<ModrigUtils::BatchFile> files;
    for (ModrigFilePath* row : tsuiEach<ModrigFilePath*>(rows))
        files.push_back({[row path], static_cast<bool>([self isTesselFolder:[row filePathName]])});
    return files;
}

- (BOOL)openTesselFolder
{
    if (!ModrigUtils::IsHostFolderOnly([self batchFilesOf:mSelectedFiles]))
        return NO;
    [self showFolder:[[mSelectedFiles objectAtIndex:0] filePathName]];
    return YES;
}

- (void)loadApps:(NSArray*)files
       successedApps:(NSMutableArray*)successedApps
    addToStartupSuit:(BOOL)addToStartupSuit
{
    if ([files count] == 0)
        return;
    [self clearMessage];
    // A copy: what is loaded may change the selection that the files come from.
    NSArray* batchFiles = [[files copy] autorelease];
    ModrigUtils::LoadBatch batch;
    batch.files = [self batchFilesOf:batchFiles];
    batch.saveHistory = mbSaveHistory;
    batch.loadAll = addToStartupSuit;
    batch.succeeded = [=](std::size_t index) { [successedApps addObject:[batchFiles objectAtIndex:index]]; };
    batch.added = [=](std::size_t index)
    { [self addRowsFor:[[batchFiles objectAtIndex:index] filePathName]]; };
    ModrigUtils::LongLoad load(self, batch.files.size());
    batch.isStopped = [&load](std::size_t done) { return load.IsStopped(done); };
    const unsigned added = ModrigUtils::RunLoadBatch(batch);
    [historyListTableView setNeedsDisplay:YES]; // it shows which files could not be loaded
    [self showLastRowAfter:added];
}

@end
