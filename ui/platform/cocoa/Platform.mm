#include <CoreServices/CoreServices.h>

#import "ui/ModrigArrayController.h"
#import "ui/NSSavePanel+ModrigRuntime.h"

#include "ui/platform/Platform.h"

@implementation ModrigArrayController

- (void)setTable:(NSTableView*)table
{
    mTable = table;
}

@end

@implementation NSSavePanel (ModrigRuntime)

- (NSButton*)okButton
{
    return [self valueForKey:@"_okButton"];
}

- (NSButton*)cancelButton
{
    return [self valueForKey:@"_cancelButton"];
}

- (NSButton*)hideExtensionButton
{
    return [self valueForKey:@"_hideExtensionButton"];
}

@end

namespace ModrigPlatform
{
NSOpenPanel* MakeOpenPanel()
{
    return [NSOpenPanel openPanel];
}

// Every panel is a new one here.
void TakePanel(NSOpenPanel*)
{
}
void GiveBackPanel(NSOpenPanel*)
{
}

// The panel sizes the frame around the view, which has to hand its size on.
void FitAccessoryView(NSView* view)
{
    [view setAutoresizingMask:[view autoresizingMask] | NSViewWidthSizable];
    NSView* frame = [view superview];
    [frame setAutoresizesSubviews:YES];
    [view setFrameOrigin:NSZeroPoint];
    [frame resizeSubviewsWithOldSize:[view frame].size];
}

// The platform follows what shows.
void UpdateKeyViews(NSWindow*)
{
}

NSString* ShownFolder(NSOpenPanel* panel)
{
    return [[panel directoryURL] path];
}

void ShowFolder(NSOpenPanel* panel, NSString* folder)
{
    [panel setDirectory:folder];
}

NSArray* SelectedPaths(NSOpenPanel* panel)
{
    return [[panel URLs] valueForKey:@"path"];
}

bool HasUnreportedSelection(NSOpenPanel*)
{
    return false;
}

// The panel filters again when it comes to a folder, so it is sent away and back.
void FilterPanelAnew(NSOpenPanel* panel, NSURL* elsewhere)
{
    [panel validateVisibleColumns];
    NSURL* folder = [[[panel directoryURL] retain] autorelease];
    [panel setDirectoryURL:elsewhere];
    [panel setDirectoryURL:folder];
}

bool FileExists(NSString* path, bool& isFolder)
{
    FSRef reference;
    Boolean folder = false;
    const auto text = reinterpret_cast<const UInt8*>([path UTF8String]);
    if (FSPathMakeRef(text, &reference, &folder) != noErr)
        return false;
    isFolder = folder;
    return true;
}

bool IsFilePackage(NSString* path)
{
    return [[NSWorkspace sharedWorkspace] isFilePackageAtPath:path];
}

// The bindings do.
void ShowRows(NSTableView*, NSArrayController*)
{
}

void AdoptTableSelection(NSTableView*, NSArrayController*)
{
}

void CompleteSegments(NSSegmentedControl*)
{
}

NSInteger TakeSegmentClick(NSSegmentedControl* segments)
{
    return [segments selectedSegment];
}
} // namespace ModrigPlatform
