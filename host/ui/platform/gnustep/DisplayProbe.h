// The X display: what a connection of our own tells about it, and the toolkit's own connection.
#pragma once

namespace tessel::windowing
{
struct DisplayFacts
{
    bool reachable = false;
    bool hasWindowManager = false;
    double dotsPerInch = 0; // that the desktop wants text to be drawn for; the screen's, when it says nothing
    double width = 0;       // pixels
    double height = 0;
};

// How much larger than usual everything is to be, in quarters, for a screen of this resolution: from 1 to 3.
double scaleFor(double dotsPerInch);

// The largest scale at which the windows of applications still have the room that they need, in quarters and
// not below 1: beyond it larger letters leave nothing that could be used.
double largestScaleOn(const DisplayFacts& display);

// Connects to the display that DISPLAY names, looks, and disconnects.
DisplayFacts probeDisplay();

// Waits until the display has done all that it was asked on the connection (the toolkit's, or null).
void completeRequests(void* display);

// Moves the keyboard to the window (an X window's number, as the toolkit hands it out) if it is on the
// screen.
void giveKeyboardTo(void* window, void* display);
} // namespace tessel::windowing
