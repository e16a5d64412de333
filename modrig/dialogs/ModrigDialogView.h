// The view of the Load/Unload dialog. Command-1 and Command-2 (Alt on a PC) go to its tabs, which no other
// key reaches on every platform.
#pragma once

#import <AppKit/AppKit.h>

#include <tesselui/tsuifilepanel.h>

@interface ModrigDialogView : NSView <TsUILowAccessory>
{
    IBOutlet NSTextField* fileTypesLabel;
    IBOutlet NSPopUpButton* fileTypesChoice;
}

@end
