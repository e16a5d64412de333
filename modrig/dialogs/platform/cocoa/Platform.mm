#include <CoreServices/CoreServices.h>

#import "modrig/dialogs/NSSavePanel+ModrigRuntime.h"

#include "modrig/dialogs/platform/Platform.h"

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
// The panel puts a frame around the view and sizes that: the frame has to size the view.
void FitAccessoryView(NSView* view)
{
    [view setAutoresizingMask:[view autoresizingMask] | NSViewWidthSizable];
    NSView* frame = [view superview];
    [frame setAutoresizesSubviews:YES];
    [view setFrameOrigin:NSZeroPoint];
    [frame resizeSubviewsWithOldSize:[view frame].size];
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
