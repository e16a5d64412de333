// Which view the keys go to, as it is shown.
#pragma once

#import <AppKit/AppKit.h>

namespace tessel::windowing
{
// Whether the keyboard is with the view, its field editor, or the list that it scrolls.
bool hasKeyboard(NSView* view);

// Lets lists and tab views be drawn again when the keyboard comes or goes. Called before the first window.
void showWhereTheKeyboardIs();
} // namespace tessel::windowing
