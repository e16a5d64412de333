// The text before a control, in the type of the controls.
#pragma once

#import <AppKit/AppKit.h>

namespace tessel::windowing
{
inline constexpr CGFloat kControlFontSize = 13;

// Lent: the view that it is put into keeps it.
NSTextField* makeLabel(NSString* text, NSRect frame);
} // namespace tessel::windowing
