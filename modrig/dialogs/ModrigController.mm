#import "modrig/dialogs/ModrigController.h"

#include <tesselui/tsuierrors.h>
#include <tesselui/tsuifilepanel.h>

#import "modrig/dialogs/ModrigStartupSuiteBox.h"
#import "modrig/dialogs/ModrigTableView.h"
#import "modrig/dialogs/TsOCModrigUtil.h"

#include "modrig/dialogs/Detaching.h"
#include "modrig/dialogs/Layout.h"
#include "modrig/dialogs/Settings.h"
#include "modrig/dialogs/model/RowInsertion.h"
#include "modrig/dialogs/platform/Dragging.h"
#include "modrig/lists/History.h"
#include "modrig/loader/LoadedApplications.h"
#include "modrig/loader/StartupSuite.h"
#include "modrig/module/EntryPoint.h"

namespace
{
struct ClosingDialog
{
    ModrigController* controller;
    NSOpenPanel* panel;
};

void cleanPanelOf(void* closing)
{
    const auto* dialog = static_cast<ClosingDialog*>(closing);
    [dialog->controller cleanOpenPanel:dialog->panel];
}
} // namespace

@implementation ModrigController

@synthesize selectedFiles = mSelectedFiles;
@synthesize saveHistory = mbSaveHistory;
@synthesize tabViewSelectedIndex;
@synthesize canUnloadApp;
@synthesize canRemoveHistory;
@synthesize message;
@synthesize shownFolder;
@synthesize furtherQuestions;

- (id)init
{
    self = [super initWithNibName:@"Modrig" bundle:[NSBundle bundleForClass:[ModrigController class]]];
    if (!self)
        return nil;
    mSelectedFiles = [[NSMutableArray alloc] init];
    mInsertRow = ModrigUtils::kAppendRow;
    message = @"";
    return self;
}

- (void)dealloc
{
    [mpUIPersistentStore release];
    self.selectedFiles = nil;
    self.message = nil;
    self.shownFolder = nil;
    self.furtherQuestions = nil;
    [super dealloc];
}

// An empty text and not nil: a field that is bound to nil shows words of the toolkit's.
- (void)clearMessage
{
    self.message = @"";
}

- (TsUIPersistentStore*)uiPersistentStore
{
    if (!mpUIPersistentStore)
        mpUIPersistentStore = [[TsUIPersistentStore alloc] init];
    return mpUIPersistentStore;
}

- (void)readSettings
{
    TsUIPersistentStore* settings = [self uiPersistentStore];
    self.saveHistory = [settings getControlState:kSettingsGroup control:kSaveHistorySetting] != 0;
    self.tabViewSelectedIndex = [settings getControlInt:kSettingsGroup control:kLastTabSetting];
}

// Only a panel that keeps its own button can end with it.
- (void)runPanel:(NSOpenPanel*)panel
{
    [self setupOpenPanel:panel];
    if ([panel runModal] == NSModalResponseOK)
        [self load:[panel URLs]];
}

- (void)showModrigDialog
{
    // At once, and not only when all else is set up: closing stores them, after a failure too.
    [self readSettings];
    ModrigUtils::PopulateLoadedApps();
    NSOpenPanel* panel = tsuiMakeFilePanel();
    NSString* cleaningFailure = nil;
    @try
    {
        [self runPanel:panel];
    }
    @finally
    {
        // What fails here must not keep the lists from being stored.
        ClosingDialog closing = {self, panel};
        cleaningFailure = tsuiErrorOf(cleanPanelOf, &closing);
        ModrigUtils::WriteStartupFilesToRegistry();
        ModrigUtils::WriteHistoryFilesToRegistry();
        ModrigUtils::updateRegistry();
    }
    if (cleaningFailure)
        [NSException raise:NSGenericException format:@"%@", cleaningFailure];
}

- (void)restoreLayout
{
    TsUIPersistentStore* settings = [self uiPersistentStore];
    ModrigUtils::RestoreFrame([[self view] window], settings, kWindowSetting);
    ModrigUtils::RestoreColumns(loadedAppsTableView, settings, kLoadedColumnSetting);
    ModrigUtils::RestoreColumns(historyListTableView, settings, kHistoryColumnSetting);
}

- (void)storeLayout
{
    TsUIPersistentStore* settings = [self uiPersistentStore];
    ModrigUtils::StoreFrame([[self view] window], settings, kWindowSetting);
    ModrigUtils::StoreColumns(loadedAppsTableView, settings, kLoadedColumnSetting);
    ModrigUtils::StoreColumns(historyListTableView, settings, kHistoryColumnSetting);
}

- (void)onInit
{
    [self readSettings];
    [TsOCModrigUtil setModrigController:self];
    [helpButton setKeyEquivalent:ModrigUtils::HelpKey()];
    NSArray* files = ModrigPlatform::DraggedFileTypes();
    [loadedAppsTableView registerForDraggedTypes:files];
    [startupSuiteBox registerForDraggedTypes:files];
    [loadedAppsTableView setDataSource:self];
    [historyListTableView setDataSource:self];
    [historyListTableView setTarget:self];
    [historyListTableView setDoubleAction:@selector(onDoubleClickHistoryTableView:)];
    [self restoreLayout];
}

- (void)storeSettings
{
    TsUIPersistentStore* settings = [self uiPersistentStore];
    [settings putControlState:kSettingsGroup control:kSaveHistorySetting state:self.saveHistory];
    [settings putControlInt:kSettingsGroup
                    control:kLastTabSetting
                      value:static_cast<int>(self.tabViewSelectedIndex)];
}

- (void)onFinish
{
    [startupSuiteBox unregisterDraggedTypes];
    [loadedAppsTableView unregisterDraggedTypes];
    [loadedAppsTableView setDataSource:nil];
    [historyListTableView setDataSource:nil];
    [self storeSettings];
    [self storeLayout];
    [TsOCModrigUtil setModrigController:nil];
    [historyListTableView setDoubleAction:nullptr];
    ModrigUtils::DetachFrom(self, [self view]);
    ModrigUtils::DetachFrom(self, helpButton); // which has left the view for the panel's button row
}

@end
