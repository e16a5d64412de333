#include "modrig/dialogs/model/TypedLetters.h"

#include <gtest/gtest.h>

#include <array>

using namespace ModrigUtils;
using std::chrono::milliseconds;

namespace
{
TypedLetters::Time At(int time)
{
    return TypedLetters::Time(milliseconds(time));
}

std::optional<std::size_t> RowFor(const wchar_t* letters, std::optional<std::size_t> current)
{
    static const std::array kNames = {L"gears.omp", L"Moon.bundle", L"gel.lsp", L"moon.lsp"};
    return RowBeginningWith(CStdStr(letters), kNames.size(), current,
                            [](std::size_t row) { return CStdStr(kNames[row]); });
}
} // namespace

TEST(TypedLetters, MakeAWordWithinASecond)
{
    TypedLetters letters;
    EXPECT_EQ(L"g", letters.Add(L'g', At(0)).Text());
    EXPECT_EQ(L"ge", letters.Add(L'e', At(999)).Text());
    EXPECT_EQ(L"m", letters.Add(L'm', At(2'000)).Text());
}

TEST(TypedLetters, AreAWordThatASpaceGoesOnWithForASecond)
{
    TypedLetters letters;
    EXPECT_FALSE(letters.IsTyping(At(0)));
    letters.Add(L'g', At(0));
    EXPECT_TRUE(letters.IsTyping(At(999)));
    EXPECT_FALSE(letters.IsTyping(At(1'000)));
}

TEST(RowBeginningWith, IsTheFirstWhateverTheCase)
{
    EXPECT_EQ(1u, RowFor(L"m", std::nullopt));
    EXPECT_EQ(2u, RowFor(L"GEL", std::nullopt));
    EXPECT_EQ(std::nullopt, RowFor(L"x", 1));
    EXPECT_EQ(std::nullopt, RowFor(L"gear.omp.longer", 0));
}

TEST(RowBeginningWith, IsTheNextForOneLetterAndGoesRoundFromTheEnd)
{
    EXPECT_EQ(3u, RowFor(L"m", 1));
    EXPECT_EQ(1u, RowFor(L"m", 3));
}

TEST(RowBeginningWith, StaysWhereItIsWhileTheWordGoesOnFitting)
{
    EXPECT_EQ(1u, RowFor(L"mo", 1));
    EXPECT_EQ(3u, RowFor(L"moon.l", 1));
}

TEST(RowBeginningWith, IsNoneInAnEmptyTable)
{
    EXPECT_EQ(std::nullopt, RowBeginningWith(CStdStr(L"m"), 0, std::nullopt, nullptr));
}

TEST(TypedLetters, AreNoKeysThatDoSomething)
{
    const TypedLetters letters;
    EXPECT_TRUE(letters.Take({L'g'}, At(0)));
    EXPECT_TRUE(letters.Take({L'!'}, At(0)));
    EXPECT_TRUE(letters.Take({0xE9}, At(0)));
    for (const wchar_t character : {kUpKey, kInsertKey, kDeleteKey, L'\r', L'\t'})
        EXPECT_FALSE(letters.Take({character}, At(0)));
    EXPECT_FALSE(letters.Take({.character = L'g', .command = true}, At(0)));
    EXPECT_FALSE(letters.Take({.character = L'g', .alternate = true}, At(0)));
}

TEST(TypedLetters, TakeASpaceOnlyWithinAWord)
{
    TypedLetters letters;
    EXPECT_FALSE(letters.Take({L' '}, At(0)));
    letters.Add(L'g', At(0));
    EXPECT_TRUE(letters.Take({L' '}, At(999)));
    EXPECT_FALSE(letters.Take({L' '}, At(1'000)));
}
