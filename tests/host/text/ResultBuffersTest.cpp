#include <gtest/gtest.h>

#include <tessel/tsresbuf.h>

#include <string>

TEST(ResultBuffers, HoldTheValuesInTheirOrder)
{
    TsResultBuffer* list =
        tsutBuildList({TsRbValue::String(L"größe"), TsRbValue::Short(-7), TsRbValue::Long(1 << 30),
                       TsRbValue::Real(0.5), TsRbValue::TrueValue(), TsRbValue::NilValue()});
    const int types[] = {TS_STRING, TS_SHORT, TS_LONG, TS_REAL, TS_TRUE, TS_NIL};
    const TsResultBuffer* at = list;
    for (const int type : types)
    {
        ASSERT_NE(at, nullptr);
        EXPECT_EQ(at->type, type);
        at = at->next;
    }
    EXPECT_EQ(at, nullptr);
    EXPECT_STREQ(list->value.string, L"größe");
    EXPECT_EQ(list->next->value.shortNumber, -7);
    EXPECT_EQ(list->next->next->value.longNumber, 1 << 30);
    EXPECT_EQ(list->next->next->next->value.real, 0.5);
    EXPECT_EQ(tsutRelRb(list), TS_NORMAL);
}

TEST(ResultBuffers, CopyTheirStrings)
{
    std::wstring text(100'000, L'x');
    TsResultBuffer* list = tsutBuildList({TsRbValue::String(text.c_str())});
    ASSERT_NE(list, nullptr);
    text[0] = L'y';
    EXPECT_EQ(std::wstring(list->value.string), std::wstring(100'000, L'x'));
    tsutRelRb(list);
}

TEST(ResultBuffers, MayBeGivenOtherTexts)
{
    TsResultBuffer* list = tsutBuildList({TsRbValue::String(L"first"), TsRbValue::String(L"second")});
    ASSERT_NE(list, nullptr);
    list->value.string = new wchar_t[]{L'o', L'w', L'n', L'\0'};
    EXPECT_STREQ(list->next->value.string, L"second");
    EXPECT_EQ(tsutRelRb(list), TS_NORMAL);
}

TEST(ResultBuffers, MayBeMadeByHand)
{
    auto* list = new TsResultBuffer{nullptr, TS_STRING, {}};
    list->value.string = new wchar_t[]{L'o', L'w', L'n', L'\0'};
    EXPECT_EQ(tsutRelRb(list), TS_NORMAL);
}

TEST(ResultBuffers, TakeNullTextForAnEmptyOne)
{
    TsResultBuffer* list = tsutBuildList({TsRbValue::String(nullptr)});
    ASSERT_NE(list, nullptr);
    EXPECT_EQ(list->type, TS_STRING);
    EXPECT_STREQ(list->value.string, L"");
    tsutRelRb(list);
}

TEST(ResultBuffers, AreNullForNoValues)
{
    EXPECT_EQ(tsutBuildList({}), nullptr);
    EXPECT_EQ(tsutRelRb(nullptr), TS_NORMAL);
}

TEST(ResultBuffers, AreFreedHoweverLongTheListIs)
{
    TsResultBuffer* list = nullptr;
    for (int i = 0; i < 200'000; ++i)
    {
        TsResultBuffer* head = tsutBuildList({TsRbValue::Long(i)});
        head->next = list;
        list = head;
    }
    EXPECT_EQ(tsutRelRb(list), TS_NORMAL);
}
