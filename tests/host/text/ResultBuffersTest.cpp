#include "host/text/ResultBuffers.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <functional>
#include <string>
#include <vector>

using testing::ElementsAreArray;

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

namespace
{
using Texts = std::vector<std::wstring>;

Texts numbered(int count)
{
    Texts texts;
    for (int i = 1; i <= count; ++i)
        texts.push_back(L"text" + std::to_wstring(i));
    return texts;
}

TsResultBuffer* listOf(const Texts& texts)
{
    const std::vector<std::wstring_view> views(texts.begin(), texts.end());
    return tessel::listOfTexts(views);
}

TsResultBuffer* at(TsResultBuffer* list, int place)
{
    while (place-- > 0)
        list = list->next;
    return list;
}

void expectToSay(const TsResultBuffer* list, const Texts& texts)
{
    Texts said;
    for (; list; list = list->next)
        said.emplace_back(list->type == TS_STRING ? list->value.string : L"not a text");
    EXPECT_THAT(said, ElementsAreArray(texts));
}

// Lists of the one text after the other, each freed before the next is built.
void expectOneAfterTheOther(const std::vector<Texts>& lists)
{
    for (const Texts& texts : lists)
    {
        TsResultBuffer* list = listOf(texts);
        expectToSay(list, texts);
        EXPECT_EQ(tsutRelRb(list), TS_NORMAL);
    }
}

// What somebody may do to a list that is his own, before he frees it.
void expectWholeAfter(const std::function<void(TsResultBuffer* list)>& change)
{
    const Texts texts = numbered(40);
    TsResultBuffer* list = listOf(texts);
    change(list);
    tsutRelRb(list);
    expectOneAfterTheOther({texts});
}
} // namespace

TEST(ListsOfTexts, SayThemInTheirOrder)
{
    EXPECT_EQ(tessel::listOfTexts({}), nullptr);
    expectOneAfterTheOther({{L"one"}, {L"b", L"", L"a", L"größe"}, numbered(1000)});
}

TEST(ListsOfTexts, SayWhatIsAskedForWhateverWasFreed)
{
    const Texts all = numbered(40);
    Texts withoutOne = all;
    withoutOne.erase(withoutOne.begin() + 20);
    Texts longerInTheMiddle = all;
    longerInTheMiddle[20] += L"0";
    Texts another = all;
    std::ranges::reverse(another);
    expectOneAfterTheOther({all,
                            all,
                            numbered(41),
                            all,
                            withoutOne,
                            all,
                            longerInTheMiddle,
                            all,
                            another,
                            all,
                            numbered(3),
                            all,
                            {},
                            all});
}

TEST(ListsOfTexts, AreNotBuiltAgainForWhatTheFreedOneSays)
{
    const Texts texts = numbered(40);
    TsResultBuffer* list = listOf(texts);
    TsResultBuffer* last = at(list, 39);
    delete[] last->value.string;
    last->value.string =
        new wchar_t[]{L't', L'e', L'x', L't', L'4', L'0', L'\0', L'm', L'a', L'r', L'k', L'\0'};
    tsutRelRb(list);
    list = listOf(numbered(41));
    EXPECT_STREQ(at(list, 39)->value.string + texts.back().size() + 1, L"mark");
    tsutRelRb(list);
}

TEST(ListsOfTexts, AreWholeAfterSomebodyChangedTheFreedOne)
{
    expectWholeAfter([](TsResultBuffer* list) { at(list, 20)->value.string[2] = L'-'; });
    expectWholeAfter([](TsResultBuffer* list) { at(list, 20)->value.string[6] = L'\0'; });
    expectWholeAfter(
        [](TsResultBuffer* list)
        {
            delete[] at(list, 20)->value.string;
            at(list, 20)->value.string = nullptr;
        });
    expectWholeAfter(
        [](TsResultBuffer* list)
        {
            delete[] at(list, 20)->value.string;
            at(list, 20)->type = TS_LONG;
            at(list, 20)->value.longNumber = 7;
        });
    expectWholeAfter([](TsResultBuffer* list) { tsutRelRb(std::exchange(at(list, 20)->next, nullptr)); });
    expectWholeAfter([](TsResultBuffer* list) { at(list, 39)->next = tsutBuildList({TsRbValue::Long(7)}); });
}

// Neither may be taken for the other while somebody has it.
TEST(ListsOfTexts, MayBeHadSeveralAtOnce)
{
    const Texts texts = numbered(40);
    TsResultBuffer* first = listOf(texts);
    TsResultBuffer* second = listOf(texts);
    tsutRelRb(first);
    TsResultBuffer* third = listOf(texts);
    at(third, 5)->value.string[0] = L'-';
    expectToSay(second, texts);
    tsutRelRb(second);
    tsutRelRb(third);
    expectOneAfterTheOther({texts});
}
