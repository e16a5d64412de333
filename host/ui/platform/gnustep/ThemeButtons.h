// The look of buttons beyond what the toolkit asks its theme for.
#pragma once

@class NSCell;

namespace tessel::windowing
{
// Whether Return stands for the button.
bool isDefaultButton(NSCell* cell);

// Writes the titles of default buttons in the colour that goes with their face, and without the picture of a
// Return key; draws segments as buttons, each by its own state. Called before the first window.
void completeButtons();

// Draws the inside of pop-up buttons, of both kinds alike.
void completePopUps();
} // namespace tessel::windowing
