#include <gmock/gmock.h>

#include "host/text/DisplayWidth.h"

using tessel::displayWidth;
using tessel::padded;
using tessel::wrapped;
using testing::ElementsAre;

TEST(DisplayWidth, CountsWideCharactersTwice)
{
    EXPECT_EQ(displayWidth(L"größe"), 5u);
    EXPECT_EQ(displayWidth(L"図面"), 4u);
    EXPECT_EQ(displayWidth(L"도면"), 4u);
    EXPECT_EQ(displayWidth(L"Ａ"), 2u) << "full width";
    EXPECT_EQ(displayWidth(L"\U0001F600"), 2u);
    EXPECT_EQ(displayWidth(L"ｱ"), 1u) << "half width";
}

TEST(DisplayWidth, CountsAccentsAndTheUnseenNotAtAll)
{
    EXPECT_EQ(displayWidth(L"a\u0308"), 1u);
    EXPECT_EQ(displayWidth(L"e\u20DD"), 1u) << "enclosed";
    EXPECT_EQ(displayWidth(L"a\u200Bb"), 2u) << "a space without width";
    EXPECT_EQ(displayWidth(L"\u1100\u1161\u11A8"), 2u) << "three parts of a Korean syllable";
    EXPECT_EQ(displayWidth(L"\u00AD"), 1u) << "terminals show soft hyphens";
}

TEST(DisplayWidth, FillsUpToAColumn)
{
    EXPECT_EQ(padded(L"図", 4), L"図  ");
    EXPECT_EQ(padded(L"a\u0308", 2), L"a\u0308 ");
    EXPECT_EQ(padded(L"long", 3), L"long");
}

TEST(DisplayWidth, BreaksTextAtBlanks)
{
    EXPECT_THAT(wrapped(L"one two three", 7), ElementsAre(L"one two", L"three"));
    EXPECT_THAT(wrapped(L"one two three", 6), ElementsAre(L"one", L"two", L"three"));
    EXPECT_THAT(wrapped(L"one   two", 4), ElementsAre(L"one", L"two"));
    EXPECT_THAT(wrapped(L"", 4), ElementsAre(L""));
    EXPECT_THAT(wrapped(L"two\nlines here", 9), ElementsAre(L"two", L"lines", L"here"));
}

TEST(DisplayWidth, BreaksAWordThatIsTooWideWhereTheLineIsFull)
{
    EXPECT_THAT(wrapped(L"abcdefg", 3), ElementsAre(L"abc", L"def", L"g"));
    EXPECT_THAT(wrapped(L"図面図", 3), ElementsAre(L"図", L"面", L"図"));
    EXPECT_THAT(wrapped(L"aa\u0308b", 2), ElementsAre(L"aa\u0308", L"b"));
    EXPECT_THAT(wrapped(L"図", 1), ElementsAre(L"図"));
    EXPECT_THAT(wrapped(L"ab", 0), ElementsAre(L"a", L"b"));
}
