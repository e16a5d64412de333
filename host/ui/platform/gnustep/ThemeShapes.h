// How the parts of the host's windows are drawn, in the colours of the theme.
#pragma once

#import <AppKit/AppKit.h>

namespace tessel::windowing
{
inline constexpr CGFloat kTabHeight = 26;
inline constexpr CGFloat kTabStart = 10;    // from the left edge to the first tab
inline constexpr CGFloat kTabPadding = 14;  // on each side of a label
inline constexpr CGFloat kTitlePadding = 4; // on each side of a box's title

struct ButtonLook
{
    bool pressed = false;
    bool disabled = false;
    bool isDefault = false; // the one that Return stands for
    bool hasFocus = false;
};

void drawButtonShape(NSRect shape, ButtonLook look);
void drawFocusRing(NSRect frame);
// A line around; answers what is inside of it.
NSRect drawBorder(NSRect frame);

void drawHeader(NSRect frame);
// The same without the line that divides columns.
void drawHeaderBackground(NSRect frame);

// A frame around controls that belong together, and what its line leaves out for its title.
void drawPane(NSRect pane);
void drawTitlePlate(NSRect frame);

// The pane of a tab view, and the selected one of the tabs above it. A flipped view counts from its top.
NSRect tabPaneOf(NSRect bounds, bool flipped);
void drawTab(NSRect tab, bool flipped);

void drawScrollTrack(NSRect bounds, bool horizontal);
void drawScrollKnob(NSRect knob, bool horizontal);

void drawMenuBackground(NSRect frame);
void drawMenuSelection(NSRect frame);
} // namespace tessel::windowing
