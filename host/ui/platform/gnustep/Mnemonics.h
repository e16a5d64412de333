// Letters that are underlined in the texts of controls, and stand for them with Alt.
#pragma once

#import <AppKit/AppKit.h>

namespace tessel::windowing
{
// Underlines them, and lets the keys do what they say. Called before the first window.
void giveControlsMnemonics();

// The label of the tab with its letter underlined.
NSAttributedString* labelOfTab(NSTabViewItem* item, NSDictionary* look);
// The text of the control, or its title, with its letter underlined.
NSAttributedString* withMnemonic(NSAttributedString* text, NSView* control);
} // namespace tessel::windowing
