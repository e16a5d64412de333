#include <gtest/gtest.h>

#include "host/lisp/LispSource.h"

using tessel::findTooDeepForm;

namespace
{
std::wstring repeated(std::wstring_view text, std::size_t times)
{
    std::wstring all;
    for (std::size_t count = 0; count < times; ++count)
        all += text;
    return all;
}
} // namespace

TEST(LispSource, AllowsNestingUpToTheLimit)
{
    EXPECT_EQ(findTooDeepForm(L"(((1)))", 3), std::nullopt);
    EXPECT_EQ(findTooDeepForm(L"((((1))))", 3), 0U);
}

TEST(LispSource, FindsWhereTheTopLevelFormBegins)
{
    EXPECT_EQ(findTooDeepForm(L"(1) ; (((\n (((2)))", 2), 11U);
}

TEST(LispSource, DoesNotAddUpWhatStandsSideBySide)
{
    EXPECT_EQ(findTooDeepForm(repeated(L"('a '(b) #'c #\\( #(1))", 1000), 4), std::nullopt);
}

TEST(LispSource, CountsMarksThatStandBeforeAForm)
{
    for (const auto* mark : {L"'", L"`", L",", L"#'", L"#.", L"' ", L"#+a ", L"#-(and a b) ", L"#1=", L"#:"})
        EXPECT_EQ(findTooDeepForm(repeated(mark, 10) + L"a", 9), 0U) << mark;
    EXPECT_EQ(findTooDeepForm(L"'('('(a)))", 6), std::nullopt);
    EXPECT_EQ(findTooDeepForm(L"'('('(a)))", 5), 0U);
}

TEST(LispSource, IgnoresParenthesesThatAreText)
{
    for (const auto* text : {L"\"(((((\"", L"|(((((|", L"; (((((\n", L"#| ((((( #| |# |#",
                             L"#\\( #\\( #\\( #\\(", L"\\(\\(\\(\\(\\("})
        EXPECT_EQ(findTooDeepForm(text, 3), std::nullopt) << text;
    EXPECT_EQ(findTooDeepForm(L"\"\\\"\" ((((1))))", 3), 5U);
    EXPECT_EQ(findTooDeepForm(L"a|(((((|b #3|((((|# a#|((((|", 3), std::nullopt);
    EXPECT_EQ(findTooDeepForm(L"#|(|# ((((1))))", 3), 6U);
}

TEST(LispSource, SurvivesTextThatEndsAnywhere)
{
    const std::wstring text = L"'(a \"b\\\"\" |c\\|| #\\( #| d |# #1=(e) `(,@f) #'g) ; h\n)";
    for (std::size_t length = 0; length <= text.size(); ++length)
        EXPECT_EQ(findTooDeepForm(std::wstring_view(text).substr(0, length), 5), std::nullopt) << length;
}

TEST(LispSource, CountsLineBreaks)
{
    EXPECT_EQ(tessel::countLineBreaks(L"a\nb\r\n\n"), 3U);
}
