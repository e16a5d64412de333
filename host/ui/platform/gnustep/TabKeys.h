// Tab views with the keyboard.
#pragma once

#import <AppKit/AppKit.h>

namespace tessel::windowing
{
// As a click on the tab does.
void selectTab(NSTabView* tabs, NSInteger index);

// Makes the row of tabs a stop of the Tab key, from which the arrows lead to its neighbours.
void letTabsHaveTheKeyboard();
} // namespace tessel::windowing
