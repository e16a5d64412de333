// Measures whether the controls of a window can all be seen, reached and read.
#pragma once

#import <AppKit/AppKit.h>

#include <string>
#include <vector>

// What is wrong below the view, a sentence each: controls that overlap or stand outside of what they are in,
// texts for which there is no room.
std::vector<std::string> layoutFaults(NSView* view);

// Makes every text below the view half as long again, as it is in other languages.
void lengthenTexts(NSView* view);

// The text with words that are half as long again: "Load" gives "LoadLo".
NSString* lengthened(NSString* text);
