#import "modrig/dialogs/ModrigController.h"

#import <tesselui/TsOCFileFilter.h>
#include <tesselui/tsuieach.h>

#import "modrig/dialogs/ModrigDialogView.h"
#import "modrig/dialogs/ModrigFolderPath.h"
#import "modrig/dialogs/NSSavePanel+ModrigRuntime.h"
#import "modrig/dialogs/NSString+ModrigPaths.h"
#import "modrig/dialogs/TsOCModrigUtil.h"

#include "modrig/dialogs/Paths.h"
#include "modrig/dialogs/Settings.h"
#include "modrig/dialogs/model/ChosenFiles.h"
#include "modrig/dialogs/model/FileVisibility.h"
#include "modrig/dialogs/platform/Platform.h"
#include "modrig/messages/MessageIds.h"
#include "modrig/types/FileFilters.h"

@implementation ModrigController (OpenPanel)

// The panel stays open when files are loaded: its default button is out of sight, and loads.
- (void)setupButtonsOf:(NSOpenPanel*)panel
{
    [[panel cancelButton] setTitle:[TsOCModrigUtil modrigLoadString:@"IDS_MODRIG_CLOSE_BUTTON"]];
    NSButton* ok = [panel okButton];
    if (!ok || ![panel cancelButton])
        return [self setupPanelWithoutButtons:panel];
    [ok setHidden:YES];
    [ok setTarget:self];
    [ok setAction:@selector(openPanelOK:)];
    [[panel cancelButton] setFrame:[ok frame]];
}

- (void)placeHelpButtonIn:(NSOpenPanel*)panel
{
    NSButton* spare = [panel hideExtensionButton];
    if (!spare || ![panel okButton])
        return [(ModrigDialogView*)[self view] keepHelpButton:helpButton];
    // Before the button that stands to its right, for the order of the Tab key.
    [[spare superview] addSubview:helpButton positioned:NSWindowBelow relativeTo:[panel cancelButton]];
    [helpButton setFrameOrigin:NSMakePoint(NSMinX([spare frame]), NSMinY([[panel okButton] frame]))];
}

- (NSString*)initialFolder
{
    NSString* stored = [[self uiPersistentStore] getControlString:kSettingsGroup control:kInitialPathSetting];
    return [stored length] ? stored : [[NSBundle mainBundle] bundlePath];
}

- (void)setupOpenPanel:(NSOpenPanel*)panel
{
    mOpenPanel = panel;
    [panel setDelegate:(id)self];
    [panel setAllowsMultipleSelection:YES];
    [self setupButtonsOf:panel];
    ModrigPlatform::ShowAccessoryView(panel, [self view]);
    [self placeHelpButtonIn:panel];
    ModrigPlatform::FitAccessoryView([self view]);
    const CStdStr title = CStdStr::OfId(ModrigMessages::kOpenPanelTitle);
    [panel setTitle:ModrigUtils::StringFromPath(title)];
    [self showFolder:[self initialFolder]];
    ModrigPlatform::ShowRows(loadedAppsTableView, loadedApps);
    ModrigPlatform::ShowRows(historyListTableView, historyList);
    [self populateFileTypes];
    [self populateLoadedApplications];
    [self populateHistoryList];
    [self onInit];
    [loadedAppsTableView sizeLastColumnToFit];
    [historyListTableView sizeLastColumnToFit];
    ModrigPlatform::UpdateKeyViews(panel);
}

- (void)cleanOpenPanel:(NSOpenPanel*)panel
{
    mOpenPanel = nil;
    [self onFinish];
    [panel setDelegate:nil];
    [panel setAccessoryView:nil];
    [helpButton removeFromSuperview];
}

- (TsOCFileFilter*)selectedFilter
{
    NSArray* filters = [fileTypes arrangedObjects];
    const NSUInteger index = [fileTypes selectionIndex];
    return index < [filters count] ? [filters objectAtIndex:index] : nil;
}

- (void)populateFileTypes
{
    NSMutableArray* filters = [NSMutableArray array];
    [TsOCModrigUtil populateModrigFileFilter:filters];
    [fileTypes addObjects:filters];
    [fileTypes setSelectionIndex:0];
    [self onFileTypesChanged:nil];
}

// The system's panel asks again about the files of a folder that it comes to: it is sent away and back.
- (void)filterPanelAgain
{
    [mOpenPanel validateVisibleColumns];
    NSURL* folder = [[ModrigPlatform::FolderOf(mOpenPanel, self.shownFolder) retain] autorelease];
    [mOpenPanel setDirectoryURL:[[NSBundle bundleForClass:[self class]] bundleURL]];
    [mOpenPanel setDirectoryURL:folder];
}

// The pop-up sends itself; nobody has chosen anything when the dialog fills it.
- (IBAction)onFileTypesChanged:(id)sender
{
    TsOCFileFilter* filter = [self selectedFilter];
    if (!filter)
        return;
    if (sender) // a failure has been told in a box, and the filter counts all the same
        static_cast<void>(
            ModrigUtils::SetRegFileFilterListIndex(ModrigUtils::PathFromString([filter description])));
    NSArray* chosen = [[mSelectedFiles copy] autorelease];
    const bool chosenInHistory = [self historyIsChosen];
    [self filterPanelAgain];
    if (!ModrigUtils::PanelSelectionCountsAfterFileType([[self chosenFiles] count] == 0, chosenInHistory))
        [mSelectedFiles setArray:chosen];
}

- (BOOL)panel:(id)panel shouldShowFilename:(NSString*)name
{
    TsOCFileFilter* filter = [self selectedFilter];
    if (!filter)
        return NO;
    NSString* path = [name stringByResolvingSymlinksAndAliasesInPath];
    ModrigUtils::PanelFile file;
    const auto kind = ModrigPlatform::FileKindAt(path);
    file.exists = kind.has_value();
    file.isFolder = kind == ModrigPlatform::FileKind::kFolder;
    file.isPackage = file.isFolder && ModrigPlatform::IsFilePackage(path);
    file.extension = ModrigUtils::PathFromString([path pathExtension]);
    file.isHostFolder = [self isTesselFolder:path];
    return ModrigUtils::IsShownInPanel(file, [panel treatsFilePackagesAsDirectories],
                                       ModrigUtils::PathsFromStrings([filter fileExtensions]));
}

// A package is a file to a person, and so is the host's, which can be gone into.
- (BOOL)isOnTheWay:(NSString*)path
{
    return ModrigPlatform::FileKindAt(path) == ModrigPlatform::FileKind::kFolder &&
           !ModrigPlatform::IsFilePackage(path) && ![self isTesselFolder:path];
}

- (BOOL)isAnyFileIn:(NSArray*)urls
{
    for (NSURL* url : tsuiEach<NSURL*>(urls))
        if (![self isOnTheWay:[url path]])
            return YES;
    return NO;
}

- (ModrigFilePath*)rowFor:(NSString*)path
{
    if ([self isOnTheWay:path])
        return [[[ModrigFolderPath alloc] initWithFilePathName:path] autorelease];
    return [[[ModrigFilePath alloc] initWithFilePathName:path] autorelease];
}

- (void)choose:(NSArray*)urls
{
    [mSelectedFiles removeAllObjects];
    for (NSURL* url : tsuiEach<NSURL*>(urls))
        [mSelectedFiles addObject:[self rowFor:[url path]]];
}

- (void)panelSelectionDidChange:(id)panel
{
    self.furtherQuestions = nil;
    [self choose:[panel URLs]];
}

- (NSArray*)chosenFiles
{
    NSMutableArray* files = [NSMutableArray array];
    for (ModrigFilePath* row : tsuiEach<ModrigFilePath*>(mSelectedFiles))
        if (![row isKindOfClass:[ModrigFolderPath class]])
            [files addObject:row];
    return files;
}

- (void)openPanelOK:(id)sender
{
    [self onLoad:sender];
}

// The path may be that of a row, which goes when the panel moves.
- (void)showFolder:(NSString*)path
{
    NSString* folder = [[path copy] autorelease];
    self.shownFolder = folder;
    ModrigPlatform::ShowFolder(mOpenPanel, folder);
}

- (BOOL)isTesselFolder:(NSString*)path
{
    return ModrigUtils::AreSamePath(path, [[NSBundle mainBundle] bundlePath]);
}

@end
