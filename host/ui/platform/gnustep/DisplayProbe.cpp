#include "host/ui/platform/gnustep/DisplayProbe.h"

#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <memory>

#include <X11/Xatom.h>
#include <X11/Xlib.h>

namespace tessel::windowing
{
namespace
{
constexpr double kUsualDotsPerInch = 96;
constexpr double kLargestScale = 3;
constexpr double kMillimetersPerInch = 25.4;
constexpr double kStepsOfScale = 4; // from 1 to 2
// What a window of many parts can do with, its frame and its title included; points.
constexpr double kLeastWidth = 750;
constexpr double kLeastHeight = 552;

struct CloseDisplay
{
    void operator()(Display* display) const { XCloseDisplay(display); }
};
using OpenDisplay = std::unique_ptr<Display, CloseDisplay>;

// A window manager that follows the Extended Window Manager Hints puts a window of its own on the root.
bool hasWindowManager(Display* display)
{
    const Atom check = XInternAtom(display, "_NET_SUPPORTING_WM_CHECK", True);
    if (check == None)
        return false;
    Atom type = None;
    int format = 0;
    unsigned long count = 0;
    unsigned long rest = 0;
    unsigned char* data = nullptr;
    const int status = XGetWindowProperty(display, DefaultRootWindow(display), check, 0, 1, False, XA_WINDOW,
                                          &type, &format, &count, &rest, &data);
    if (data)
        XFree(data);
    return status == Success && count == 1;
}

double dotsPerInch(Display* display)
{
    if (const char* wanted = XGetDefault(display, "Xft", "dpi"))
        if (const double dots = std::strtod(wanted, nullptr); dots > 0)
            return dots;
    const int screen = DefaultScreen(display);
    const int millimeters = DisplayHeightMM(display, screen);
    return millimeters > 0 ? DisplayHeight(display, screen) * kMillimetersPerInch / millimeters : 0;
}
} // namespace

double scaleFor(double dotsPerInch)
{
    return std::clamp(std::round(dotsPerInch / kUsualDotsPerInch * kStepsOfScale) / kStepsOfScale, 1.0,
                      kLargestScale);
}

double largestScaleOn(const DisplayFacts& display)
{
    const double scale = std::min(display.width / kLeastWidth, display.height / kLeastHeight);
    return std::max(1.0, std::floor(scale * kStepsOfScale) / kStepsOfScale);
}

DisplayFacts probeDisplay()
{
    const OpenDisplay display(XOpenDisplay(nullptr));
    if (!display)
        return {};
    const int screen = DefaultScreen(display.get());
    return {.reachable = true,
            .hasWindowManager = hasWindowManager(display.get()),
            .dotsPerInch = dotsPerInch(display.get()),
            .width = static_cast<double>(DisplayWidth(display.get(), screen)),
            .height = static_cast<double>(DisplayHeight(display.get(), screen))};
}

void completeRequests(void* display)
{
    if (display)
        XSync(static_cast<Display*>(display), False);
}

void giveKeyboardTo(void* window, void* display)
{
    const auto xWindow = reinterpret_cast<Window>(window);
    auto* connection = static_cast<Display*>(display);
    XWindowAttributes attributes;
    if (xWindow != None && XGetWindowAttributes(connection, xWindow, &attributes) &&
        attributes.map_state == IsViewable)
        XSetInputFocus(connection, xWindow, RevertToParent, CurrentTime);
}
} // namespace tessel::windowing
