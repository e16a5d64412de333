#include "host/ui/platform/gnustep/filepanel/Layout.h"

#include <algorithm>

namespace tessel::filepanel
{
namespace
{
constexpr double kWays = 40;
constexpr double kName = 36;
constexpr double kButtons = 42;
constexpr double kSmallestList = 84; // header and three rows
} // namespace

Layout layoutFor(double height, double accessoryHeight)
{
    const double missing = std::max(0.0, smallestHeight(accessoryHeight) - height);
    Layout layout;
    layout.buttons = {0, kButtons};
    layout.accessory = {kButtons, std::max(0.0, accessoryHeight - missing)};
    layout.name = {layout.accessory.bottom + layout.accessory.height, kName};
    layout.list.bottom = layout.name.bottom + kName;
    layout.ways = {height - kWays, kWays};
    layout.list.height = layout.ways.bottom - layout.list.bottom;
    return layout;
}

double smallestHeight(double accessoryHeight)
{
    return kWays + kSmallestList + kName + accessoryHeight + kButtons;
}
} // namespace tessel::filepanel
