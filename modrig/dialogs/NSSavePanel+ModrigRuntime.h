// The parts of a file panel that the toolkit keeps to itself.
#pragma once

#import <AppKit/AppKit.h>

@interface NSSavePanel (ModrigRuntime)

// The default button, which double-click and Return press.
- (NSButton*)okButton;
- (NSButton*)cancelButton;
// An unused place on the button row.
- (NSButton*)hideExtensionButton;

@end
