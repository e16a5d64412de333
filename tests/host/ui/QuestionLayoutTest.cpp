#include <gtest/gtest.h>

#include "host/ui/QuestionLayout.h"

using namespace tessel::asking;

namespace
{
constexpr double kPlenty = 1000;
constexpr double kLine = 20;

double topOf(const Band& part)
{
    return part.bottom + part.height;
}
} // namespace

TEST(QuestionLayout, StacksWhatThereIsFromTheButtonsUp)
{
    const QuestionLayout layout = layoutOf({.text = kLine, .explanation = kLine, .hasField = true}, kPlenty);
    EXPECT_EQ(layout.buttons.bottom, kMargin);
    EXPECT_EQ(layout.buttons.height, kButtonHeight);
    EXPECT_GT(layout.explanation.bottom, topOf(layout.buttons));
    EXPECT_EQ(layout.explanation.height, kLine);
    EXPECT_GT(layout.field.bottom, topOf(layout.explanation));
    EXPECT_EQ(layout.field.height, kFieldHeight);
    EXPECT_GT(layout.text.bottom, topOf(layout.field));
    EXPECT_EQ(layout.text.height, kLine);
    EXPECT_EQ(layout.height, topOf(layout.text) + kMargin);
}

TEST(QuestionLayout, LeavesNoRoomForWhatThereIsNot)
{
    const double whole = layoutOf({.text = kLine, .explanation = kLine, .hasField = true}, kPlenty).height;
    const QuestionLayout withoutField =
        layoutOf({.text = kLine, .explanation = kLine, .hasField = false}, kPlenty);
    EXPECT_LT(withoutField.height, whole - kFieldHeight);
    EXPECT_LT(layoutOf({.text = kLine, .explanation = 0, .hasField = true}, kPlenty).height, whole - kLine);
    const QuestionLayout least = layoutOf({.text = kLine, .explanation = 0, .hasField = false}, kPlenty);
    EXPECT_EQ(least.text.bottom, topOf(least.buttons) + kMargin);
}

TEST(QuestionLayout, GrowsWithItsText)
{
    const double one = layoutOf({.text = kLine, .explanation = 0, .hasField = true}, kPlenty).height;
    EXPECT_EQ(layoutOf({.text = 5 * kLine, .explanation = 0, .hasField = true}, kPlenty).height,
              one + 4 * kLine);
}

TEST(QuestionLayout, IsNoHigherThanTheScreenWhateverTheText)
{
    const QuestionLayout layout = layoutOf({.text = 5000, .explanation = kLine, .hasField = true}, 500);
    EXPECT_EQ(layout.height, 500);
    EXPECT_EQ(topOf(layout.text), 500 - kMargin);
}

TEST(QuestionLayout, ShowsAFewLinesOfTheTextOnAnyScreen)
{
    const QuestionLayout layout = layoutOf({.text = 5000, .explanation = 0, .hasField = true}, 10);
    EXPECT_GE(layout.text.height, 2 * kLine);
    EXPECT_LT(layout.text.height, 4 * kLine);
    EXPECT_EQ(layoutOf({.text = kLine, .explanation = 0, .hasField = true}, 10).text.height, kLine);
}

TEST(QuestionLayout, LetsALongExplanationScroll)
{
    const QuestionLayout layout = layoutOf({.text = kLine, .explanation = 5000, .hasField = true}, kPlenty);
    EXPECT_GE(layout.explanation.height, 3 * kLine);
    EXPECT_LE(layout.explanation.height, 6 * kLine);
}
