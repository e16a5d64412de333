#include "modrig/dialogs/model/WindowPlace.h"

#include <algorithm>

namespace ModrigUtils
{
namespace
{
double Within(double value, double least, double most)
{
    return std::max(least, std::min(value, most));
}
} // namespace

Frame OnScreen(Frame remembered, const Frame& screen, double leastWidth, double leastHeight)
{
    Frame frame;
    frame.width = std::max(leastWidth, std::min(remembered.width, screen.width));
    frame.height = std::max(leastHeight, std::min(remembered.height, screen.height));
    frame.x = Within(remembered.x, screen.x, screen.x + screen.width - frame.width);
    // A window that is too high for the screen keeps its upper edge there.
    const double highest = screen.y + screen.height - frame.height;
    frame.y = std::min(highest, std::max(remembered.y, screen.y));
    return frame;
}
} // namespace ModrigUtils
