// Where the parts of the file panel stand, from the panel's size. Measures are points, from the lower edge.
#pragma once

namespace tessel::filepanel
{
struct Extent
{
    double bottom = 0;
    double height = 0;
};

struct Layout
{
    Extent ways; // the row with the folders on the way
    Extent list;
    Extent name; // the row with the name field
    Extent accessory;
    Extent buttons;
};

// `accessoryHeight`: what the accessory view asks for. The list gives way first, down to three rows; then the
// accessory view does.
Layout layoutFor(double height, double accessoryHeight);

// The height at which the list shows three rows and everything else has what it asks for.
double smallestHeight(double accessoryHeight);
} // namespace tessel::filepanel
