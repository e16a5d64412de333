// The panel in which files are chosen. On macOS it is the system's; elsewhere the host brings its own, with
// the interface of the toolkit's panel.
#pragma once

#import <AppKit/AppKit.h>

#include "../tessel/tsdefs.h"

// Where the panel is the host's own, its buttons are found in its content view by these tags: the default
// button, the one that cancels, and a hidden one that keeps a place at the start of their row.
inline constexpr NSInteger kTsUIFilePanelDefaultButton = 100;
inline constexpr NSInteger kTsUIFilePanelCancelButton = 101;
inline constexpr NSInteger kTsUIFilePanelSpareButton = 102;

// What an accessory view implements that can be less high than it comes: on a low screen the host's own panel
// makes it so, after its list has given way, down to this height in points.
@protocol TsUILowAccessory
- (CGFloat)tsuiSmallestHeight;
@end

// A new file panel, autoreleased, which disturbs no other one that is open. `URLs` holds the chosen files, of
// rows or of typed names; a folder on the way is none. Its delegate decides what is listed
// (`panel:shouldShowFilename:`) and hears of every choice (`panelSelectionDidChange:`); the default button
// ends the panel unless the delegate refuses one of the files (`panel:validateURL:error:`).
// `validateVisibleColumns` asks it again, and keeps folder, selection and place. `runModal` ends with
// NSModalResponseOK unless the default button has been given another target.
TESSEL_API NSOpenPanel* tsuiMakeFilePanel();

// Tells the person in a message box when what stands in the name field names no file; answers whether it did.
TESSEL_API bool tsuiTellOfMissingFile(NSOpenPanel* panel);
