// What the windows of the host need from the platform.
#pragma once

#import <AppKit/AppKit.h>

namespace tessel::windowing
{
// Whether a display answers.
bool displayIsReachable();

// Before anything else: the folder (a path that need not exist) in which the toolkit keeps what it remembers
// and what it complains about.
void prepareToolkit(NSString* folder);

// Before the application object is made: the look that is read once.
void chooseLook();

// After it is made, before the first window: the look of the windows, and how they behave.
void completeLook();
void completeBehaviour();

// Calls the function whenever a loop is about to wait for an event, on the main thread. Called once.
void callBeforeEachWait(void (*call)());

// Shows a message of the host, with the sign of a warning or of mere information, until it is answered.
// `detail` (or an empty text) says why, in smaller type that can be selected and copied.
void runMessage(NSString* text, NSString* detail, bool warning);

// Lets a person choose a file in a panel that opens in the folder with the name in it, which may be empty.
// nil when they cancel. `mayBeNew`: the file need not be there.
NSString* chooseFile(NSString* folder, NSString* name, bool mayBeNew);

// Puts the view into the panel, in sight.
void showAccessoryView(NSOpenPanel* panel, NSView* view);

// Sends the panel into the folder. It may get there later.
void showFolder(NSOpenPanel* panel, NSString* folder);

// Before windows open: the program gets the keyboard.
void comeToFront();

// After the last has closed: what the screen still has to show is carried out, and the keyboard goes back to
// whoever had it.
void leaveScreen();
} // namespace tessel::windowing
