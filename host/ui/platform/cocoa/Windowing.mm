#include "host/ui/platform/Windowing.h"

#include <CoreGraphics/CoreGraphics.h>

#include <tesselui/tsuifilepanel.h>

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
} // namespace tessel::windowing

// The system's panel, a new one at each call.
NSOpenPanel* tsuiMakeFilePanel()
{
    return [NSOpenPanel openPanel];
}

// The system's panel has no field for names.
bool tsuiTellOfMissingFile(NSOpenPanel*)
{
    return false;
}
