// A window of its own file that runs modally, over another one.
#pragma once

#import <AppKit/AppKit.h>

@interface TsOCModalWindowController : NSWindowController

// Takes the window from the file that `windowNibName` names, in the bundle of the controller's class.
- (id)init;

// The name of the window file, without its extension; a subclass answers it. The file's owner is the
// controller, with its `window` outlet connected.
- (NSString*)windowNibName;

// Shows the window centred over the parent (nil: centred on the screen) and returns when it has been closed:
// by its close button, by Escape, or by `closeModalWindow:`. The parent takes no clicks meanwhile and stays
// behind the window.
- (void)showModalWindowCenterOfParent:(NSWindow*)parent;

// Called when the window is about to show, its outlets connected, and when it has been closed. Do nothing
// here.
- (void)doInit;
- (void)doClean;

// Ends the modal run.
- (IBAction)closeModalWindow:(id)sender;

@end
