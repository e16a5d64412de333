#include "host/ui/platform/gnustep/WindowHints.h"

#include <climits>
#include <string>

#include <unistd.h>

#include <X11/Xatom.h>
#include <X11/Xlib.h>
#include <X11/Xutil.h>

namespace tessel::windowing
{
namespace
{
void set(Display* display, Window window, const char* property, Atom type, unsigned long value)
{
    XChangeProperty(display, window, XInternAtom(display, property, False), type, 32, PropModeReplace,
                    reinterpret_cast<const unsigned char*>(&value), 1);
}

void setAtom(Display* display, Window window, const char* property, const char* value)
{
    set(display, window, property, XA_ATOM, XInternAtom(display, value, False));
}

// The number of a process means something on its machine only.
void nameMachine(Display* display, Window window)
{
    char name[HOST_NAME_MAX + 1] = {};
    gethostname(name, sizeof name - 1);
    char* list[] = {name};
    XTextProperty machine;
    if (!XStringListToTextProperty(list, 1, &machine))
        return;
    XSetWMClientMachine(display, window, &machine);
    XFree(machine.value);
}

void setOwner(Display* display, Window window, Window owner)
{
    XSetTransientForHint(display, window, owner);
    setAtom(display, window, "_NET_WM_WINDOW_TYPE", "_NET_WM_WINDOW_TYPE_DIALOG");
    setAtom(display, window, "_NET_WM_STATE", "_NET_WM_STATE_MODAL");
}
} // namespace

int connectionNumber(void* display)
{
    return XConnectionNumber(static_cast<Display*>(display));
}

bool isOnScreen(unsigned long window, void* display)
{
    XWindowAttributes attributes;
    return window != None && XGetWindowAttributes(static_cast<Display*>(display), window, &attributes) &&
           attributes.map_state != IsUnmapped;
}

void introduceWindow(unsigned long window, unsigned long owner, void* display)
{
    if (window == None)
        return;
    auto* connection = static_cast<Display*>(display);
    set(connection, window, "_NET_WM_PID", XA_CARDINAL, static_cast<unsigned long>(getpid()));
    nameMachine(connection, window);
    if (owner != None)
        setOwner(connection, window, owner);
}
} // namespace tessel::windowing
