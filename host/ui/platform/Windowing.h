// What the windows of the host need from the platform.
#pragma once

#import <AppKit/AppKit.h>

namespace tessel::windowing
{
// Whether a display answers.
bool displayIsReachable();

// Before the application object is made: the look that is read once.
void chooseLook();

// After it is made, before the first window.
void completeLook();
void acceptFileDrops();
// Lets every window be closed by its frame: file panels are cancelled then, message boxes answered.
void makeWindowsClosable();
// Lets a window that opens right after another has closed get the keyboard.
void letNewWindowsHaveTheKeyboard();

// Carries out what the screen still has to show.
void flushScreen();
} // namespace tessel::windowing
