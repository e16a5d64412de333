#import "ui/ModrigArrayController.h"
#import "ui/NSSavePanel+ModrigRuntime.h"

#include <tesselui/tsuieach.h>
#include <tesselui/tsuierrors.h>

#include <sys/stat.h>

#include <iterator>

#include "ui/platform/Platform.h"

// The panel's own idea of its folder does not follow the browser, which is asked instead.
@interface NSSavePanel (ModrigBrowser)
- (NSString*)modrigShownFolder;
- (NSArray*)modrigSelectedPaths;
- (NSString*)modrigTypedPath;
- (void)modrigFilterAnew;
- (void)modrigForgetName;
@end

@implementation NSSavePanel (ModrigRuntime)

- (NSButton*)okButton
{
    return _okButton;
}

- (NSButton*)cancelButton
{
    return [[self contentView] viewWithTag:NSFileHandlingPanelCancelButton];
}

// The toolkit's panel has none; the button that leads to the home folder stands at the start of the row.
- (NSButton*)hideExtensionButton
{
    return [[self contentView] viewWithTag:NSFileHandlingPanelHomeButton];
}

@end

@implementation NSSavePanel (ModrigBrowser)

- (NSString*)modrigShownFolder
{
    // Until the panel runs, the browser is still at the folder of its last run.
    if (![self isVisible])
        return [self directory];
    return [[_browser pathToColumn:[_browser lastColumn]] stringByStandardizingPath];
}

- (NSArray*)modrigSelectedPaths
{
    if (NSString* typed = [self modrigTypedPath])
        return [NSArray arrayWithObject:typed];
    NSMutableArray* paths = [NSMutableArray array];
    if ([_browser selectedColumn] == [_browser lastColumn])
        for (NSBrowserCell* cell : tsuiEach<NSBrowserCell*>([_browser selectedCells]))
            if ([cell isLeaf])
                [paths
                    addObject:[[self modrigShownFolder] stringByAppendingPathComponent:[cell stringValue]]];
    return paths;
}

// What stands in the name field, if it names a file that exists. It is the selected file's name unless the
// user types another; with several files selected it is empty. A folder is a place on the way.
- (NSString*)modrigTypedPath
{
    NSString* name = [[_form cellAtIndex:0] stringValue];
    NSString* path = [[self modrigShownFolder] stringByAppendingPathComponent:name];
    if ([name isAbsolutePath] || [name hasPrefix:@"~"])
        path = [name stringByExpandingTildeInPath];
    bool isFolder = false;
    if (![name length] || !ModrigPlatform::FileExists(path, isFolder))
        return nil;
    return isFolder && !ModrigPlatform::IsFilePackage(path) ? nil : path;
}

// -validateVisibleColumns would empty the columns of the browser and lose the path.
- (void)modrigFilterAnew
{
    NSString* folder = [[[self modrigShownFolder] retain] autorelease];
    [_browser loadColumnZero];
    [_browser setPath:folder];
    [_okButton setEnabled:NO];
    [self modrigForgetName];
}

// The browser forgets what was selected, the field with its name does not.
- (void)modrigForgetName
{
    [[_form cellAtIndex:0] setStringValue:@""];
    [[_form currentEditor] setString:@""];
}

@end

namespace ModrigPlatform
{
namespace
{
// A button of the shared panel as it was.
struct ButtonState
{
    NSButton* button;
    NSString* title;
    id target;
    SEL action;
    NSRect frame;
    BOOL hidden;
    NSUInteger resizing;
};

constexpr CGFloat kPanelMargin = 8;

// Everything on the panel's button row: it is the dialog's while that is open.
constexpr NSInteger kButtonTags[] = {NSFileHandlingPanelOKButton, NSFileHandlingPanelCancelButton,
                                     NSFileHandlingPanelHomeButton, NSFileHandlingPanelDiskButton,
                                     NSFileHandlingPanelDiskEjectButton};
ButtonState gButtons[std::size(kButtonTags)];

// What the dialog has last been told to be selected.
NSArray* gReportedPaths = nil;

void report(NSArray* paths)
{
    [paths retain];
    [gReportedPaths release];
    gReportedPaths = paths;
}

// The toolkit tells of clicks only.
void tellOfLostSelection(NSOpenPanel* panel)
{
    if (ModrigPlatform::HasUnreportedSelection(panel))
        [[panel delegate] panelSelectionDidChange:panel];
}

ButtonState stateOf(NSButton* button)
{
    return {button,         [[button title] retain], [button target],          [button action],
            [button frame], [button isHidden],       [button autoresizingMask]};
}

void giveBack(const ButtonState& state)
{
    [state.button setTitle:state.title];
    [state.button setTarget:state.target];
    [state.button setAction:state.action];
    [state.button setFrame:state.frame];
    [state.button setHidden:state.hidden];
    [state.button setAutoresizingMask:state.resizing];
    [state.title release];
}

NSString* nearestFolder(NSString* path)
{
    bool isFolder = false;
    while ([path length] > 1 && !(ModrigPlatform::FileExists(path, isFolder) && isFolder))
        path = [path stringByDeletingLastPathComponent];
    return path;
}

// The browser raises an exception when a folder that it shows, /tmp, say, changes under it. It has the new
// state the next time. What still does not work then shows on the screen.
constexpr int kMostTries = 5;

void persist(void (*change)(void*), void* argument)
{
    for (int tries = 0; tries < kMostTries && tsuiErrorOf(change, argument); ++tries)
        ;
}

struct FolderChange
{
    NSOpenPanel* panel;
    NSString* folder;
};

void changeFolder(void* change)
{
    const auto* wanted = static_cast<FolderChange*>(change);
    [wanted->panel setDirectory:wanted->folder];
    [wanted->panel modrigForgetName];
}

void filterAnew(void* panel)
{
    [static_cast<NSOpenPanel*>(panel) modrigFilterAnew];
}

// A folder that is only walked through would count as selected.
void allowFilesOnly(void* panel)
{
    [static_cast<NSOpenPanel*>(panel) setCanChooseDirectories:NO];
}

// What leads to other disks is of no use among a host's applications. The first of those buttons keeps a
// place at the start of the row.
void clearButtonRow(NSView* panelView)
{
    for (const NSInteger tag :
         {NSFileHandlingPanelHomeButton, NSFileHandlingPanelDiskButton, NSFileHandlingPanelDiskEjectButton})
        [[panelView viewWithTag:tag] setHidden:YES];
    NSButton* first = [panelView viewWithTag:NSFileHandlingPanelHomeButton];
    [first setFrameOrigin:NSMakePoint(kPanelMargin, NSMinY([first frame]))];
    [first setAutoresizingMask:NSViewMaxXMargin];
}
} // namespace

// A new one: +openPanel answers one object for the whole program, and its window is drawn out of place when
// it has shown an accessory view once and is to show one again.
NSOpenPanel* MakeOpenPanel()
{
    return [[[NSOpenPanel alloc] init] autorelease];
}

void TakePanel(NSOpenPanel* panel)
{
    NSView* panelView = [panel contentView];
    for (std::size_t index = 0; index < std::size(kButtonTags); ++index)
        gButtons[index] = stateOf([panelView viewWithTag:kButtonTags[index]]);
    report(nil);
    persist(allowFilesOnly, panel);
    clearButtonRow(panelView);
}

void GiveBackPanel(NSOpenPanel*)
{
    report(nil);
    for (const ButtonState& state : gButtons)
        giveBack(state);
}

// The panel has placed the view among its own parts already; there is no frame around it to fill.
void FitAccessoryView(NSView* view)
{
    [view setAutoresizingMask:[view autoresizingMask] | NSViewWidthSizable];
}

// The toolkit works it out once, and not anew when another tab shows.
void UpdateKeyViews(NSWindow* window)
{
    [window recalculateKeyViewLoop];
}

NSString* ShownFolder(NSOpenPanel* panel)
{
    return [panel modrigShownFolder];
}

// Without the delegate, which might hide a folder on the way, and to the nearest folder that there is: the
// browser raises an exception when it cannot get through.
void ShowFolder(NSOpenPanel* panel, NSString* folder)
{
    id delegate = [panel delegate];
    [panel setDelegate:nil];
    FolderChange change = {panel, nearestFolder(folder)};
    persist(changeFolder, &change);
    [panel setDelegate:delegate];
    tellOfLostSelection(panel);
}

NSArray* SelectedPaths(NSOpenPanel* panel)
{
    report([panel modrigSelectedPaths]);
    return gReportedPaths;
}

bool HasUnreportedSelection(NSOpenPanel* panel)
{
    NSArray* paths = [panel modrigSelectedPaths];
    return [paths count] + [gReportedPaths count] > 0 && ![paths isEqual:gReportedPaths];
}

void FilterPanelAnew(NSOpenPanel* panel, NSURL*)
{
    persist(filterAnew, panel);
    tellOfLostSelection(panel);
}

bool FileExists(NSString* path, bool& isFolder)
{
    struct stat status;
    if (stat([path fileSystemRepresentation], &status) != 0)
        return false;
    isFolder = S_ISDIR(status.st_mode);
    return true;
}

bool IsFilePackage(NSString* path)
{
    return [[NSWorkspace sharedWorkspace] isFilePackageAtPath:path];
}

// Bindings lead from the controller to the table only.
// A bound column watches every row, and fetches what all of them show anew for each cell that it draws.
void ShowRows(NSTableView* table, NSArrayController* rows)
{
    for (NSTableColumn* column : tsuiEach<NSTableColumn*>([table tableColumns]))
        [column unbind:NSValueBinding];
    [(ModrigArrayController*)rows setTable:table];
    [table reloadData];
}

void AdoptTableSelection(NSTableView* table, NSArrayController* rows)
{
    [rows setSelectionIndexes:[table selectedRowIndexes]];
}

// Labels are lost on the way from the window file.
void CompleteSegments(NSSegmentedControl* segments)
{
    [segments setLabel:@"+" forSegment:0];
    [segments setLabel:@"\u2212" forSegment:1];
}

// A click on a disabled segment repeats the last one unless that has been taken back.
NSInteger TakeSegmentClick(NSSegmentedControl* segments)
{
    const NSInteger clicked = [segments selectedSegment];
    if (clicked >= 0)
        [segments setSelected:NO forSegment:clicked];
    return clicked;
}
} // namespace ModrigPlatform
