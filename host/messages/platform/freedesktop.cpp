#include "host/messages/platform/Desktop.h"

#include <cstdlib>

namespace tessel
{
bool hasDisplay()
{
    return std::getenv("DISPLAY") || std::getenv("WAYLAND_DISPLAY");
}

std::vector<std::string> pageOpeners()
{
    return {"xdg-open", "x-www-browser"};
}
} // namespace tessel
