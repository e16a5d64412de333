#include <gmock/gmock.h>

#include "host/ui/platform/gnustep/filepanel/Layout.h"

using namespace tessel::filepanel;

namespace
{
constexpr double kAccessory = 336;

void expectStacked(const Layout& layout, double height)
{
    double edge = 0;
    for (const Extent& extent : {layout.buttons, layout.accessory, layout.name, layout.list, layout.ways})
    {
        EXPECT_EQ(edge, extent.bottom);
        edge += extent.height;
    }
    EXPECT_EQ(height, edge);
}
} // namespace

TEST(PanelLayout, StacksItsPartsWithoutGapsAtEverySize)
{
    for (const double height : {450.0, 500.0, 538.0, 700.0, 1200.0})
        expectStacked(layoutFor(height, kAccessory), height);
    expectStacked(layoutFor(400, 0), 400);
}

TEST(PanelLayout, LetsTheListGrowAndGiveWayFirst)
{
    const double smallest = smallestHeight(kAccessory);
    const double list = layoutFor(smallest, kAccessory).list.height;
    EXPECT_EQ(list + 200, layoutFor(smallest + 200, kAccessory).list.height);
    EXPECT_EQ(kAccessory, layoutFor(smallest + 200, kAccessory).accessory.height);
    EXPECT_EQ(kAccessory, layoutFor(smallest, kAccessory).accessory.height);
    EXPECT_EQ(list, layoutFor(smallest - 50, kAccessory).list.height);
    EXPECT_EQ(kAccessory - 50, layoutFor(smallest - 50, kAccessory).accessory.height);
}

TEST(PanelLayout, OfTheDialogFitsTheSmallestScreen)
{
    constexpr double kTitleBar = 28;
    EXPECT_LE(smallestHeight(kAccessory) + kTitleBar, 600);
}
