#include "modrig/dialogs/platform/Dragging.h"

namespace ModrigPlatform
{
NSArray* DraggedFileTypes()
{
    return [NSArray arrayWithObject:NSFilenamesPboardType];
}

NSArray* PathsOn(NSPasteboard* pasteboard)
{
    return [pasteboard propertyListForType:NSFilenamesPboardType];
}
} // namespace ModrigPlatform
