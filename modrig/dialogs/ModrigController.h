// The Load/Unload Applications dialog: the host's file panel (tesselui/tsuifilepanel.h), with this
// controller's view in it.
//
// The module's lists are the truth; the array controllers show them, and every action changes both. There is
// one dialog at a time (see `TsOCModrigUtil`). Main thread only.
#pragma once

#import <AppKit/AppKit.h>
#import <tesselui/TsUIPersistentStore.h>

@class ModrigStartupSuiteBox;

@interface ModrigController : NSViewController
{
    NSMutableArray* mSelectedFiles;
    NSOpenPanel* mOpenPanel;
    BOOL mbSaveHistory;
    BOOL mbUpdatingFileNameField;
    int mInsertRow;
    TsUIPersistentStore* mpUIPersistentStore;
    IBOutlet NSArrayController* fileTypes;
    IBOutlet NSArrayController* loadedApps;
    IBOutlet NSArrayController* historyList;
    IBOutlet NSTableView* loadedAppsTableView;
    IBOutlet NSTableView* historyListTableView;
    IBOutlet NSButton* helpButton;
    IBOutlet ModrigStartupSuiteBox* startupSuiteBox;
    NSInteger tabViewSelectedIndex;
    BOOL canUnloadApp;
    BOOL canRemoveHistory;
    NSString* message;
    NSString* shownFolder;
    NSArray* furtherQuestions;
}

// What was chosen last, in the panel or in the History: `ModrigFilePath`s. Load leaves those of folders out.
@property (nonatomic, retain) NSMutableArray* selectedFiles;
@property (nonatomic, assign) BOOL saveHistory;
// `kLoadedApplicationsTab` or `kHistoryTab` (model/ShownTab.h).
@property (nonatomic, assign) NSInteger tabViewSelectedIndex;
@property (nonatomic, assign) BOOL canUnloadApp;
@property (nonatomic, assign) BOOL canRemoveHistory;
// The message line.
@property (nonatomic, retain) NSString* message;
// The path of the folder that the panel was sent to or has told of last; it may still be on its way there.
@property (nonatomic, copy) NSString* shownFolder;
// The URLs of the files that have been loaded, and that the panel may still ask about.
@property (nonatomic, copy) NSArray* furtherQuestions;

- (id)init;

// Opens the dialog, returns when it is closed, and stores the lists then, whatever was done in it.
- (void)showModrigDialog;

// The two halves of opening and closing that the panel's set-up and clean-up call.
- (void)onInit;
- (void)onFinish;

// An action begins: what an earlier one has said is no answer to it.
- (void)clearMessage;

- (TsUIPersistentStore*)uiPersistentStore;

@end

// ModrigController+Tables.mm: the tables and what their buttons do.
@interface ModrigController (Tables) <NSTableViewDataSource, NSTableViewDelegate>

- (void)populateLoadedApplications;
- (void)populateHistoryList;

- (void)tableViewSelectionDidChange:(NSNotification*)notification;
- (BOOL)tableView:(NSTableView*)table shouldSelectRow:(NSInteger)row;
// Takes rows that cannot be unloaded out of the selection: new rows come selected, whatever they are.
- (void)keepToUnloadableRows;

// Makes the rows that are selected in the History what Load will load.
- (void)chooseFromHistory;
// Whether they are that now.
- (BOOL)historyIsChosen;

- (void)tabView:(NSTabView*)tabView didSelectTabViewItem:(NSTabViewItem*)item;

- (IBAction)onLoadFromHistory:(id)sender;
- (IBAction)onDoubleClickHistoryTableView:(id)sender;
- (IBAction)onAddToStartupSuiteFromHistory:(id)sender;
- (IBAction)onRemove:(id)sender;
- (IBAction)onUnload:(id)sender;

@end

// ModrigController+Loading.mm
@interface ModrigController (Loading)

- (IBAction)onLoad:(id)sender;
// Moves the panel into the host's own folder when that is all that is selected, and answers whether it did.
- (BOOL)openTesselFolder;

- (IBAction)onStartupSuits:(id)sender;
- (IBAction)onHelp:(id)sender;

// All loading goes through here. Loads the `ModrigFilePath`s in order, up to the first that fails, with rows
// for those newly loaded. `successedApps` (or nil) receives those that are loaded now, newly or since before.
- (void)loadApps:(NSArray*)files
       successedApps:(NSMutableArray*)successedApps
    addToStartupSuit:(BOOL)addToStartupSuit;

@end

// ModrigController+OpenPanel.mm: the file panel around the view.
@interface ModrigController (OpenPanel)

- (void)setupOpenPanel:(NSOpenPanel*)panel;
- (void)cleanOpenPanel:(NSOpenPanel*)panel;

- (void)populateFileTypes;
- (IBAction)onFileTypesChanged:(id)sender;

- (BOOL)panel:(id)panel shouldShowFilename:(NSString*)name;
// What is selected in the panel is what was chosen last then, folders too.
- (void)panelSelectionDidChange:(id)panel;
- (void)choose:(NSArray*)urls;
// Whether there is anything among the URLs but folders on the way to files.
- (BOOL)isAnyFileIn:(NSArray*)urls;
// What Load loads of what was chosen last.
- (NSArray*)chosenFiles;
// The action of the panel's default button.
- (void)openPanelOK:(id)sender;

- (BOOL)isTesselFolder:(NSString*)path;
- (void)showFolder:(NSString*)path;

@end

// ModrigController+SystemPanel.mm: what a panel needs and asks that keeps its buttons to itself, as the
// system's on macOS does: it has one that ends it, which loads instead.
@interface ModrigController (SystemPanel)

- (void)setupPanelWithoutButtons:(NSOpenPanel*)panel;

- (BOOL)panel:(id)panel shouldEnableURL:(NSURL*)url;
// Loads these, whatever was chosen in the History before: who presses the panel's own button means the
// panel's files.
- (void)load:(NSArray*)urls;
// Loads all that the panel has chosen at the first of its questions, and answers NO: the panel stays.
- (BOOL)panel:(id)panel validateURL:(NSURL*)url error:(NSError**)error;
- (void)panel:(id)panel didChangeToDirectoryURL:(NSURL*)url;

@end

// ModrigController+DragAndDrop.mm: files dropped on the tables and on the Startup Suite box.
@interface ModrigController (DragAndDrop)

- (NSDragOperation)tableView:(NSTableView*)table
                validateDrop:(id<NSDraggingInfo>)info
                 proposedRow:(NSInteger)row
       proposedDropOperation:(NSTableViewDropOperation)operation;
- (BOOL)tableView:(NSTableView*)table
       acceptDrop:(id<NSDraggingInfo>)info
              row:(NSInteger)row
    dropOperation:(NSTableViewDropOperation)operation;
- (void)loadedAppsTableViewDropFiles:(NSArray*)paths atRow:(NSInteger)row;
// The History takes no files.
- (void)historyTableViewDropFiles:(NSArray*)paths atRow:(NSInteger)row;

- (NSDragOperation)draggingEnteredStartupSuite:(id<NSDraggingInfo>)info;
- (BOOL)performDragOperationToStartupSuite:(id<NSDraggingInfo>)info;

// Loads the files (path strings), up to 50 of them, with their rows at `row` (-1: at the end), and takes
// those that are loaded then into the Startup Suite if asked to.
- (void)dropFiles:(NSArray*)paths atRow:(NSInteger)row addToStartupList:(BOOL)addToStartupList;

@end
