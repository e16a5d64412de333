#include "modrig/dialogs/platform/Dragging.h"

namespace ModrigPlatform
{
namespace
{
NSArray* pathsOfAddresses(NSPasteboard* pasteboard)
{
    NSDictionary* filesOnly = [NSDictionary dictionaryWithObject:[NSNumber numberWithBool:YES]
                                                          forKey:NSPasteboardURLReadingFileURLsOnlyKey];
    NSArray* addresses = [pasteboard readObjectsForClasses:[NSArray arrayWithObject:[NSURL class]]
                                                   options:filesOnly];
    return [addresses count] ? [addresses valueForKey:@"path"] : nil;
}
} // namespace

// Paths in one list, as long as the system has that, and one address for each file since.
NSArray* DraggedFileTypes()
{
    return [NSArray arrayWithObjects:NSPasteboardTypeFileURL, NSFilenamesPboardType, nil];
}

NSArray* PathsOn(NSPasteboard* pasteboard)
{
    NSArray* paths = [pasteboard propertyListForType:NSFilenamesPboardType];
    return paths ? paths : pathsOfAddresses(pasteboard);
}
} // namespace ModrigPlatform
