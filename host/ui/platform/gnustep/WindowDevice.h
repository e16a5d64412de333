// The number that the X display knows a window by.
#pragma once

#import <AppKit/AppKit.h>
#import <GNUstepGUI/GSDisplayServer.h>

namespace tessel::windowing
{
// 0 for no window.
inline unsigned long deviceOf(NSWindow* window)
{
    return window ? reinterpret_cast<unsigned long>(
                        [GSServerForWindow(window) windowDevice:static_cast<int>([window windowNumber])])
                  : 0;
}
} // namespace tessel::windowing
