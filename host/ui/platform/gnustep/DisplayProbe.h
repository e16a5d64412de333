// What a connection of our own tells about the X display.
#pragma once

namespace tessel::windowing
{
struct DisplayFacts
{
    bool reachable = false;
    bool hasWindowManager = false;
};

// Connects to the display that DISPLAY names, looks, and disconnects.
DisplayFacts probeDisplay();
} // namespace tessel::windowing
