// The look of segmented controls.
#pragma once

namespace tessel::windowing
{
// Lets segments be drawn as buttons are, each by its own state. Called before the first window.
void drawSegmentsAsButtons();
} // namespace tessel::windowing
