#include "host/ui/platform/Windowing.h"

#include <CoreGraphics/CoreGraphics.h>

namespace tessel::windowing
{
bool displayIsReachable()
{
    // A process outside of a login session has no window server to talk to.
    NSDictionary* session = [(NSDictionary*)CGSessionCopyCurrentDictionary() autorelease];
    return session != nil;
}

// The platform's own look, and its own file drops.
void chooseLook()
{
}

void completeLook()
{
    [NSApp setActivationPolicy:NSApplicationActivationPolicyRegular];
}

void acceptFileDrops()
{
}

void flushScreen()
{
}

// No window of the platform is ended from outside, and a new one has the keyboard.
void makeWindowsClosable()
{
}

void letNewWindowsHaveTheKeyboard()
{
}

NSOpenPanel* makeOpenPanel()
{
    return [NSOpenPanel openPanel];
}

void filterAnew(NSOpenPanel* panel)
{
    [panel validateVisibleColumns];
}

NSArray* chosenPaths(NSOpenPanel* panel)
{
    return [[panel URLs] valueForKey:@"path"];
}

void showFilesOf(NSOpenPanel* panel, NSString* folder)
{
    [panel setCanChooseDirectories:NO];
    if (folder)
        [panel setDirectoryURL:[NSURL fileURLWithPath:folder]];
}
} // namespace tessel::windowing
