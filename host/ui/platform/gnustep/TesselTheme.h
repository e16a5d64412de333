// The toolkit asks its theme to draw what it shows; what is not overridden here keeps the toolkit's look.
// TesselTheme.mm draws buttons, fields and their frames, the categories what their names say.
#pragma once

#import <AppKit/AppKit.h>
#import <GNUstepGUI/GSTheme.h>

@interface TesselTheme : GSTheme
@end

namespace tessel::windowing
{
// A colour of the theme's own list of extra colours; of the toolkit's names for colours, NSColor answers.
NSColor* themeColor(NSString* name);

// Lets tables have a header as wide as they are, and scrollers no arrow buttons.
void completeTables();

// Shows tool tips whole, in the theme's colours.
void completeToolTips();
} // namespace tessel::windowing
