// The view of the Load/Unload dialog. Alt-1 and Alt-2 (Option-Command on macOS) go to its tabs, which no
// other key reaches on every platform.
#pragma once

#import <AppKit/AppKit.h>

#include <tesselui/tsuifilepanel.h>

@interface ModrigDialogView : NSView <TsUILowAccessory>
{
    IBOutlet NSTextField* fileTypesLabel;
    IBOutlet NSPopUpButton* fileTypesChoice;
    IBOutlet NSTextField* messageLine;
}

// The Help button stays in the view, at the end of the line of the message, where a panel has no place for
// it.
- (void)keepHelpButton:(NSButton*)button;

@end
