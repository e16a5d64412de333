// The look of the host's windows: flat, light or dark as the desktop is, with one accent colour.
#pragma once

#import <AppKit/AppKit.h>

namespace tessel::windowing
{
// Takes colours and pictures from the folder of the theme for light desktops, or from the one for dark ones
// beside it (nil: the toolkit's own look), and the shapes from code. Called when the application object has
// been made, before the first window.
void useTheme(NSString* folder);
} // namespace tessel::windowing
