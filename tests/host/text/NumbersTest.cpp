#include <gtest/gtest.h>

#include <wincompat/winfile.h>

#include <climits>
#include <string>

namespace
{
std::wstring itow(int value, int base)
{
    wchar_t buffer[33 + 1];
    buffer[33] = L'!';
    EXPECT_EQ(ms_itow(value, buffer, base), buffer);
    EXPECT_EQ(buffer[33], L'!');
    return buffer;
}
} // namespace

TEST(NumbersAsText, AreSignedInDecimalOnly)
{
    EXPECT_EQ(itow(0, 10), L"0");
    EXPECT_EQ(itow(-42, 10), L"-42");
    EXPECT_EQ(itow(-1, 16), L"ffffffff");
    EXPECT_EQ(itow(-1, 8), L"37777777777");
    EXPECT_EQ(itow(35, 36), L"z");
}

TEST(NumbersAsText, HoldTheExtremes)
{
    EXPECT_EQ(itow(INT_MAX, 10), L"2147483647");
    EXPECT_EQ(itow(INT_MIN, 10), L"-2147483648");
    EXPECT_EQ(itow(INT_MIN, 2), L"1" + std::wstring(31, L'0'));
    EXPECT_EQ(itow(-1, 2), std::wstring(32, L'1'));
}

TEST(NumbersAsText, AreEmptyForABaseThatThereIsNot)
{
    for (const int base : {-10, 0, 1, 37})
        EXPECT_EQ(itow(7, base), L"");
}

TEST(NumbersAsText, TakeNullForNoBuffer)
{
    EXPECT_EQ(ms_itow(7, nullptr, 10), nullptr);
}
