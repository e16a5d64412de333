#include <gmock/gmock.h>

#include "host/ui/platform/gnustep/filepanel/RowSelection.h"

using testing::ElementsAre;
using testing::IsEmpty;
using namespace tessel::filepanel;

namespace
{
constexpr Keys kNone{};
constexpr Keys kShift{true, false};
constexpr Keys kControl{false, true};
} // namespace

TEST(RowsAfterAClick, AreThatRowAlone)
{
    const auto rows = afterClick({{1, 2}, 1, 2}, 5, kNone, true);
    EXPECT_THAT(rows.rows, ElementsAre(5));
    EXPECT_EQ(5u, rows.anchor);
    EXPECT_EQ(5u, rows.lead);
}

TEST(RowsAfterAClick, AreTheRangeFromTheAnchorWithShift)
{
    auto rows = afterClick({{3}, 3, 3}, 5, kShift, true);
    EXPECT_THAT(rows.rows, ElementsAre(3, 4, 5));
    rows = afterClick(rows, 1, kShift, true);
    EXPECT_THAT(rows.rows, ElementsAre(1, 2, 3)) << "the anchor stays";
}

TEST(RowsAfterAClick, GainOrLoseARowWithControl)
{
    auto rows = afterClick({{3}, 3, 3}, 5, kControl, true);
    EXPECT_THAT(rows.rows, ElementsAre(3, 5));
    rows = afterClick(rows, 3, kControl, true);
    EXPECT_THAT(rows.rows, ElementsAre(5));
    EXPECT_THAT(afterClick(rows, 1, kShift, true).rows, ElementsAre(1, 2, 3)) << "ranges go on from there";
}

TEST(RowsAfterAClick, AreOneWhereNoMoreAreAllowed)
{
    EXPECT_THAT(afterClick({{3}, 3, 3}, 5, kShift, false).rows, ElementsAre(5));
    EXPECT_THAT(afterClick({{3}, 3, 3}, 5, kControl, false).rows, ElementsAre(5));
}

TEST(RowsAfterAKey, AreTheNextOneWithinTheList)
{
    EXPECT_THAT(afterStep({{3}, 3, 3}, 1, kNone, 10, true).rows, ElementsAre(4));
    EXPECT_THAT(afterStep({{3}, 3, 3}, -1, kNone, 10, true).rows, ElementsAre(2));
    EXPECT_THAT(afterStep({{3}, 3, 3}, 100, kNone, 10, true).rows, ElementsAre(9));
    EXPECT_THAT(afterStep({{3}, 3, 3}, -100, kNone, 10, true).rows, ElementsAre(0));
    EXPECT_THAT(afterStep({{3}, 3, 3}, 1, kNone, 0, true).rows, IsEmpty());
}

TEST(RowsAfterAKey, GrowAndShrinkWithShift)
{
    auto rows = afterStep({{3}, 3, 3}, 1, kShift, 10, true);
    rows = afterStep(rows, 1, kShift, 10, true);
    EXPECT_THAT(rows.rows, ElementsAre(3, 4, 5));
    rows = afterStep(rows, -1, kShift, 10, true);
    EXPECT_THAT(rows.rows, ElementsAre(3, 4));
}

TEST(RowsAfterAKey, BeginWithTheFirstRow)
{
    EXPECT_THAT(afterStep({}, 1, kNone, 10, true).rows, ElementsAre(0));
    EXPECT_THAT(afterStep({}, 1, kShift, 10, true).rows, ElementsAre(0));
    EXPECT_THAT(afterStep({}, -1, kNone, 10, true).rows, ElementsAre(0));
}
