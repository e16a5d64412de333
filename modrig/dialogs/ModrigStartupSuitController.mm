#import "modrig/dialogs/ModrigStartupSuitController.h"

#import <tesselui/TsOCOpenFileDialog.h>
#import <tesselui/TsUIPersistentStore.h>

#import "modrig/dialogs/ModrigController.h"
#import "modrig/dialogs/ModrigFilePath.h"
#import "modrig/dialogs/ModrigTableView.h"
#import "modrig/dialogs/TsOCModrigUtil.h"

#include "modrig/dialogs/Layout.h"
#include "modrig/dialogs/Paths.h"
#include "modrig/dialogs/Settings.h"
#include "modrig/dialogs/TableRows.h"
#include "modrig/dialogs/platform/Platform.h"
#include "modrig/lists/FileIntake.h"
#include "modrig/lists/ListMembership.h"
#include "modrig/lists/ListRemoval.h"
#include "modrig/messages/MessageIds.h"
#include "modrig/messages/Messages.h"

namespace
{
constexpr NSInteger kAddSegment = 0;
constexpr NSInteger kRemoveSegment = 1;
} // namespace

@interface ModrigStartupSuitController (Segments)
- (void)enableRemove:(BOOL)enabled;
@end

@implementation ModrigStartupSuitController

- (NSString*)windowNibName
{
    return @"ModrigStartupSuit";
}

- (id)init
{
    return [super init];
}

- (void)doInit
{
    ModrigPlatform::CompleteSegments(segmentedControl);
    TsUIPersistentStore* settings = [[[TsUIPersistentStore alloc] init] autorelease];
    ModrigUtils::RestoreFrame([self window], settings, kSuiteWindowSetting);
    ModrigUtils::RestoreColumns(startupTableView, settings, kSuiteColumnSetting);
    ModrigPlatform::ShowRows(startupTableView, startupApps);
    ModrigUtils::FillTable(startupApps, ModrigUtils::StartupSuiteFiles());
    [self enableRemove:NO];
}

- (void)enableRemove:(BOOL)enabled
{
    [segmentedControl setEnabled:enabled forSegment:kRemoveSegment];
    [segmentedControl setNeedsDisplay:YES]; // not every toolkit draws the segment again by itself
}

- (void)doClean
{
    TsUIPersistentStore* settings = [[[TsUIPersistentStore alloc] init] autorelease];
    ModrigUtils::StoreFrame([self window], settings, kSuiteWindowSetting);
    ModrigUtils::StoreColumns(startupTableView, settings, kSuiteColumnSetting);
}

- (IBAction)onSegmentedButton:(id)sender
{
    switch (ModrigPlatform::TakeSegmentClick(sender))
    {
    case kAddSegment:
        return [self onAdd];
    case kRemoveSegment:
        return [self onRemove];
    default:
        return;
    }
}

// Wherever in the window the keyboard is: the table's keys, and the one for help.
- (void)keyDown:(NSEvent*)event
{
    if ([[event charactersIgnoringModifiers] isEqual:ModrigUtils::HelpKey()])
        return [self help:nil];
    if (![(ModrigTableView*)startupTableView takeKey:event])
        [super keyDown:event];
}

- (void)onAdd
{
    NSAutoreleasePool* pool = [[NSAutoreleasePool alloc] init];
    TsOCOpenFileDialog* dialog = [[[TsOCOpenFileDialog alloc] init] autorelease];
    const CStdStr title = CStdStr::OfId(ModrigMessages::kStartupSuitePanelTitle);
    [dialog setTitle:ModrigUtils::StringFromPath(title)];
    [dialog setInitialPath:[[NSBundle mainBundle] bundlePath]];
    [dialog setAllowsMultipleSelection:YES];
    NSMutableArray* filters = [NSMutableArray array];
    [TsOCModrigUtil populateModrigFileFilter:filters];
    [dialog setFileFilters:filters];
    if ([dialog runModal] == NSModalResponseOK)
        [self addFiles:[dialog selectedPathes]];
    [pool drain];
}

- (void)onRemove
{
    if ([[startupApps selectedObjects] count] == 0)
        return;
    [[TsOCModrigUtil getModrigController] clearMessage];
    ModrigUtils::RemoveFromStartupSuite(ModrigUtils::TakeSelectedRows(startupApps));
}

- (NSInteger)numberOfRowsInTableView:(NSTableView*)table
{
    return static_cast<NSInteger>([[startupApps arrangedObjects] count]);
}

- (id)tableView:(NSTableView*)table objectValueForTableColumn:(NSTableColumn*)column row:(NSInteger)row
{
    return ModrigUtils::ValueInRow(startupApps, column, row);
}

- (void)addFiles:(NSArray*)paths
{
    [[TsOCModrigUtil getModrigController] clearMessage];
    NSArray* files =
        ModrigUtils::RowsFromPaths(ModrigUtils::FilesNewToStartupSuite(ModrigUtils::PathsFromStrings(paths)));
    NSMutableArray* loaded = [NSMutableArray array];
    [[TsOCModrigUtil getModrigController] loadApps:files successedApps:loaded addToStartupSuit:YES];
    NSArrayController* rows = startupApps;
    ModrigUtils::StartupSuiteTable table;
    table.hasRow = [=](std::size_t index)
    { return static_cast<bool>([[rows arrangedObjects] containsObject:[loaded objectAtIndex:index]]); };
    table.addRow = [=](std::size_t index) { [rows addObject:[loaded objectAtIndex:index]]; };
    if (ModrigUtils::AddToShownStartupSuite(ModrigUtils::PathsFromRows(loaded), table) > 0)
        [startupTableView scrollRowToVisible:[self numberOfRowsInTableView:startupTableView] - 1];
}

- (void)tableViewSelectionDidChange:(NSNotification*)notification
{
    if ([notification object] != startupTableView)
        return;
    ModrigPlatform::AdoptTableSelection(startupTableView, startupApps);
    [self enableRemove:[[startupApps selectedObjects] count] > 0];
}

- (IBAction)help:(id)sender
{
    ModrigUtils::OnCommandHelp(ModrigUtils::kStartupSuiteHelp);
}

@end
