// The look of the host's windows: flat, light, with one accent colour.
#pragma once

#import <AppKit/AppKit.h>

namespace tessel::windowing
{
// Takes the colours from the theme's folder (nil: the toolkit's own) and the shapes from code. Called when
// the application object has been made, before the first window.
void useTheme(NSString* folder);
} // namespace tessel::windowing
