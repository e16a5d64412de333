// How the parts of the host's windows are drawn.
#pragma once

#import <AppKit/AppKit.h>

namespace tessel::windowing
{
inline constexpr CGFloat kTabHeight = 26;
inline constexpr CGFloat kTabStart = 10;   // from the left edge to the first tab
inline constexpr CGFloat kTabPadding = 14; // on each side of a label

void drawButtonShape(NSRect shape, bool pressed, bool disabled);
void drawFocusRing(NSRect frame);
// A line around; answers what is inside of it.
NSRect drawBorder(NSRect frame);
void drawHeader(NSRect frame);

// The pane of a tab view, and the selected one of the tabs above it. A flipped view counts from its top.
NSRect tabPaneOf(NSRect bounds, bool flipped);
void drawTabPane(NSRect pane);
void drawTab(NSRect tab, bool flipped);

void drawScrollTrack(NSRect bounds, bool horizontal);
void drawScrollKnob(NSRect knob, bool horizontal);
} // namespace tessel::windowing
