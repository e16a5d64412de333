// Files that are dragged here from other programs.
#pragma once

#import <AppKit/AppKit.h>

namespace ModrigPlatform
{
// What a drag of files may call them.
NSArray* DraggedFileTypes();

// The paths of the files that lie on the pasteboard, strings; nil when there are none.
NSArray* PathsOn(NSPasteboard* pasteboard);
} // namespace ModrigPlatform
