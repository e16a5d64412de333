#include <CoreServices/CoreServices.h>

#import "modrig/dialogs/NSSavePanel+ModrigRuntime.h"

#include "modrig/dialogs/platform/Platform.h"

namespace
{
// A panel that another process draws has none of them, and raises for a name that it does not know.
NSButton* partNamed(NSSavePanel* panel, NSString* name)
{
    @try
    {
        id part = [panel valueForKey:name];
        return [part isKindOfClass:[NSButton class]] ? part : nil;
    }
    @catch (id)
    {
        return nil;
    }
}
} // namespace

@implementation NSSavePanel (ModrigRuntime)

- (NSButton*)okButton
{
    return partNamed(self, @"_okButton");
}

- (NSButton*)cancelButton
{
    return partNamed(self, @"_cancelButton");
}

- (NSButton*)hideExtensionButton
{
    return partNamed(self, @"_hideExtensionButton");
}

@end

namespace ModrigPlatform
{
// The panel puts a frame around the view and sizes that: the frame has to size the view.
void FitAccessoryView(NSView* view)
{
    [view setAutoresizingMask:[view autoresizingMask] | NSViewWidthSizable];
    NSView* frame = [view superview];
    [frame setAutoresizesSubviews:YES];
    [view setFrameOrigin:NSZeroPoint];
    [frame resizeSubviewsWithOldSize:[view frame].size];
}

// The panel hides it behind a button of its own unless it is told not to.
void ShowAccessoryView(NSOpenPanel* panel, NSView* view)
{
    [panel setAccessoryView:view];
    [panel setAccessoryViewDisclosed:YES];
}

void ShowFolder(NSOpenPanel* panel, NSString* folder)
{
    [panel setDirectory:folder];
    [panel setDirectoryURL:[NSURL fileURLWithPath:folder isDirectory:YES]];
}

// The panel is on its way for a while, and answers until then where it was before.
NSURL* FolderOf(NSOpenPanel* panel, NSString* known)
{
    return known ? [NSURL fileURLWithPath:known isDirectory:YES] : [panel directoryURL];
}

// The platform does so by itself when another tab shows.
void UpdateKeyViews(NSWindow*)
{
}

std::optional<FileKind> FileKindAt(NSString* path)
{
    FSRef reference;
    Boolean folder = false;
    const auto text = reinterpret_cast<const UInt8*>([path UTF8String]);
    if (FSPathMakeRef(text, &reference, &folder) != noErr)
        return std::nullopt;
    return folder ? FileKind::kFolder : FileKind::kFile;
}

bool IsFilePackage(NSString* path)
{
    return [[NSWorkspace sharedWorkspace] isFilePackageAtPath:path];
}

// The bindings of the window file do it, in both directions.
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
