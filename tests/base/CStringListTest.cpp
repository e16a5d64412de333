#include "modrig/base/CStringList.h"

#include <string>
#include <type_traits>
#include <vector>

#include <gmock/gmock.h>

#include "modrig/base/SplitPath.h"
#include "tests/support/ModuleTest.h"

using testing::ElementsAre;
using testing::IsEmpty;

TEST(StringList, BeginsEmpty)
{
    const CStringList list;
    EXPECT_TRUE(list.IsEmpty());
    EXPECT_EQ(0u, list.GetCount());
    EXPECT_EQ(list.begin(), list.end());
    EXPECT_FALSE(list.HoldsApplication(L""));
}

TEST(StringList, KeepsTheOrderInWhichEntriesWereAppendedAndDuplicatesToo)
{
    CStringList list;
    list.AddTail(L"b");
    list.AddTail(L"a");
    list.AddTail(L"b");
    EXPECT_THAT(Texts(list), ElementsAre(L"b", L"a", L"b"));
    EXPECT_EQ(3u, list.GetCount());
}

TEST(StringList, ErasesTheFirstEqualEntryOnly)
{
    CStringList list;
    for (const wchar_t* text : {L"x", L"TOOL.LSP", L"y", L"tool.lsp", L"Tool.lsp"})
        list.AddTail(text);
    EXPECT_TRUE(list.RemoveFirstNoCase(L"tool.LSP"));
    EXPECT_THAT(Texts(list), ElementsAre(L"x", L"y", L"tool.lsp", L"Tool.lsp"));
    EXPECT_TRUE(list.RemoveFirstNoCase(L"TOOL.lsp"));
    EXPECT_THAT(Texts(list), ElementsAre(L"x", L"y", L"Tool.lsp"));
}

TEST(StringList, ErasesTheFirstEqualEntryAmongManyThatWereAppendedAndErasedBefore)
{
    CStringList list;
    for (int round = 0; round < 50; ++round)
    {
        list.AddTail(L"/a/TOOL.lsp");
        list.AddTail(L"/a/tool.lsp");
        EXPECT_TRUE(list.RemoveFirstNoCase(L"/A/Tool.lsp"));
    }
    ASSERT_EQ(50u, list.GetCount());
    for (int round = 0; round < 50; ++round)
    {
        const std::wstring head = list.begin()->Text();
        EXPECT_EQ(round % 2 == 0 ? L"/a/TOOL.lsp" : L"/a/tool.lsp", head);
        EXPECT_TRUE(list.RemoveFirstNoCase(L"/a/tool.LSP"));
    }
    EXPECT_TRUE(list.IsEmpty());
}

TEST(StringList, AnswersFalseWhenThereIsNothingToErase)
{
    CStringList list;
    list.AddTail(L"/a/tool.omp");
    EXPECT_FALSE(list.RemoveFirstNoCase(L"/b/tool.omp"));
    EXPECT_FALSE(list.RemoveFirstNoCase(L""));
    EXPECT_EQ(1u, list.GetCount());
}

TEST(StringList, IsEmptyAndFindsNothingAfterRemoveAll)
{
    CStringList list;
    list.AddTail(L"/a/tool.lsp");
    list.RemoveAll();
    EXPECT_THAT(Texts(list), IsEmpty());
    EXPECT_FALSE(list.HoldsApplication(L"/a/tool.lsp"));
    list.AddTail(L"/a/other.lsp");
    EXPECT_THAT(Texts(list), ElementsAre(L"/a/other.lsp"));
}

TEST(StringList, FindsNoEntryThatWasErased)
{
    CStringList list;
    list.AddTail(L"/a/tool.omp");
    EXPECT_TRUE(list.RemoveFirstNoCase(L"/A/TOOL.OMP"));
    EXPECT_FALSE(list.HoldsApplication(L"/a/tool.omp"));
}

TEST(StringList, IteratorsWalkForwardsInBothForms)
{
    CStringList list;
    list.AddTail(L"a");
    list.AddTail(L"bc");
    auto position = list.begin();
    EXPECT_EQ(L"a", (position++)->Text());
    EXPECT_EQ(2u, position->Text().size());
    EXPECT_EQ(list.end(), ++position);
}

TEST(StringList, CannotBeCopiedApartFromItsIndex)
{
    EXPECT_FALSE(std::is_copy_constructible_v<CStringList>);
    EXPECT_FALSE(std::is_copy_assignable_v<CStringList>);
}

TEST(StringList, TheRuleIsAskedOfTheEntryAndNotOfTheTarget)
{
    const SplitPath module(CStdStr(L"/a/tool.omp"));
    const SplitPath elsewhere(CStdStr(L"/b/TOOL.OMP"));
    const SplitPath bundle(CStdStr(L"/a/tool.bundle"));
    EXPECT_TRUE(MatchesEntry(module, elsewhere));
    EXPECT_FALSE(MatchesEntry(bundle, SplitPath(CStdStr(L"/b/tool.bundle"))));
    EXPECT_TRUE(MatchesEntry(bundle, SplitPath(CStdStr(L"/A/Tool.BUNDLE"))));
    EXPECT_FALSE(MatchesEntry(bundle, module));
}
