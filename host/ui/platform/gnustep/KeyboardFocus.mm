// The toolkit asks for the keyboard with the time of the last event that it has seen. The display ignores
// that when the window manager has moved the keyboard since, as it does when a window closes: a window that
// opens soon after would never get it. Here it is asked for again, with the present time.
#import <AppKit/AppKit.h>
#import <GNUstepGUI/GSDisplayServer.h>

#include "host/platform/gnustep/StandIn.h"
#include "host/ui/platform/gnustep/Behaviour.h"
#include "host/ui/platform/gnustep/DisplayProbe.h"

namespace tessel::windowing
{
namespace
{
using SetInputFocus = void (*)(id, SEL, int);
SetInputFocus toolkitSetInputFocus;

void setInputFocus(id server, SEL selector, int window)
{
    toolkitSetInputFocus(server, selector, window);
    giveKeyboardTo([server windowDevice:window], [server serverDevice]);
}
} // namespace

void letNewWindowsHaveTheKeyboard()
{
    toolkitSetInputFocus = standInFor("XGServer", @selector(setinputfocus:), setInputFocus);
}
} // namespace tessel::windowing
