#include "host/ui/platform/gnustep/DropSelection.h"

#include <memory>
#include <optional>

#include <poll.h>

#include <X11/Xatom.h>
#include <X11/Xlib.h>

namespace tessel::windowing
{
namespace
{
constexpr int kWaitSteps = 50;
constexpr int kWaitStepMilliseconds = 20;
constexpr long kMostUriWords = 1 << 20; // of 4 bytes
constexpr unsigned long kProtocolVersion = 3;

struct FreeProperty
{
    void operator()(unsigned char* data) const { XFree(data); }
};

// A connection of our own: the toolkit's is busy with its own events, and asking on it would take some away
// from it. Kept for the life of the process, like the toolkit's.
struct Connection
{
    Display* display = XOpenDisplay(nullptr);
    Window window =
        display ? XCreateSimpleWindow(display, DefaultRootWindow(display), -5, -5, 1, 1, 0, 0, 0) : None;

    Atom atom(const char* name) const { return XInternAtom(display, name, False); }
};

Connection& connection()
{
    static Connection shared;
    return shared;
}

std::string readProperty(const Connection& x, Atom property)
{
    Atom type = None;
    int format = 0;
    unsigned long count = 0;
    unsigned long rest = 0;
    unsigned char* data = nullptr;
    if (XGetWindowProperty(x.display, x.window, property, 0, kMostUriWords, True, AnyPropertyType, &type,
                           &format, &count, &rest, &data) != Success)
        return {};
    const std::unique_ptr<unsigned char, FreeProperty> owner(data);
    // Text comes in single bytes; an answer in pieces (type INCR) is a number, and too long for file names.
    return data && format == 8 ? std::string(reinterpret_cast<char*>(data), count) : std::string();
}

// The answer, if it is among what has arrived.
std::optional<std::string> takeAnswer(const Connection& x, Atom property)
{
    while (XPending(x.display))
    {
        XEvent event;
        XNextEvent(x.display, &event);
        if (event.type != SelectionNotify || event.xselection.requestor != x.window)
            continue;
        return event.xselection.property == None ? std::string() : readProperty(x, property);
    }
    return std::nullopt;
}
} // namespace

std::string fetchDraggedUris()
{
    const Connection& x = connection();
    if (!x.display)
        return {};
    const Atom property = x.atom("TESSEL_DROP");
    XConvertSelection(x.display, x.atom("XdndSelection"), x.atom("text/uri-list"), property, x.window,
                      CurrentTime);
    XFlush(x.display);
    for (int step = 0; step < kWaitSteps; ++step)
    {
        if (const auto answer = takeAnswer(x, property))
            return *answer;
        pollfd descriptor = {ConnectionNumber(x.display), POLLIN, 0};
        poll(&descriptor, 1, kWaitStepMilliseconds);
    }
    return {};
}

unsigned long windowEntered(const void* event)
{
    return static_cast<const XEvent*>(event)->xclient.window;
}

void announceDropTarget(unsigned long window)
{
    const Connection& x = connection();
    if (!x.display || !window)
        return;
    XChangeProperty(x.display, window, x.atom("XdndAware"), XA_ATOM, 32, PropModeReplace,
                    reinterpret_cast<const unsigned char*>(&kProtocolVersion), 1);
    XSync(x.display, False);
}
} // namespace tessel::windowing
