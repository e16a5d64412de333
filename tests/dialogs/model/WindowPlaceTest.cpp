#include "modrig/dialogs/model/WindowPlace.h"

#include <gtest/gtest.h>

using ModrigUtils::Frame;
using ModrigUtils::OnScreen;

namespace
{
constexpr Frame kScreen = {10, 40, 1000, 700};

void ExpectFrame(const Frame& expected, const Frame& frame)
{
    EXPECT_EQ(expected.x, frame.x);
    EXPECT_EQ(expected.y, frame.y);
    EXPECT_EQ(expected.width, frame.width);
    EXPECT_EQ(expected.height, frame.height);
}
} // namespace

TEST(WindowPlace, IsTheRememberedOneWhereItFits)
{
    ExpectFrame({100, 60, 600, 500}, OnScreen({100, 60, 600, 500}, kScreen, 400, 300));
}

TEST(WindowPlace, MovesOntoTheScreen)
{
    ExpectFrame({410, 240, 600, 500}, OnScreen({2000, 900, 600, 500}, kScreen, 400, 300));
    ExpectFrame({10, 40, 600, 500}, OnScreen({-900, -900, 600, 500}, kScreen, 400, 300));
}

TEST(WindowPlace, IsNoLargerThanTheScreenAndNoSmallerThanTheWindowCanBe)
{
    ExpectFrame({10, 40, 1000, 700}, OnScreen({0, 0, 3000, 2000}, kScreen, 400, 300));
    ExpectFrame({100, 60, 400, 300}, OnScreen({100, 60, 20, 10}, kScreen, 400, 300));
}

TEST(WindowPlace, KeepsTheTitleBarInSightOfAWindowThatIsTooHigh)
{
    ExpectFrame({10, -60, 1000, 800}, OnScreen({10, 40, 1000, 700}, kScreen, 400, 800));
}
