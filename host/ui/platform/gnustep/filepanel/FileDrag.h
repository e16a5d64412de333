// Dragging files from the panel to a view of the same window that takes files. The toolkit's own drags need
// its pasteboard server, a program beside the host, and do not arrive in a window that runs modally.
#pragma once

#import <AppKit/AppKit.h>

// The drag, and its pasteboard, as a destination asks them.
@interface TsFileDrag : NSObject
{
    NSArray* mPaths;
    NSView* mSource;
    NSView* mDestination; // the view under the mouse that takes files
    NSWindow* mLabel;
    NSPoint mPlace; // of the mouse, in the window
    NSDragOperation mOperation;
}

- (id)initWithPaths:(NSArray*)paths from:(NSView*)source;

// Returns when the button has been released, or Escape pressed.
- (void)run;

@end
