#include "modrig/base/CaseFolding.h"

#include <clocale>
#include <random>
#include <string>
#include <vector>

#include <gtest/gtest.h>
#include <unicode/uchar.h>

namespace
{
constexpr int kLastCodePoint = 0x10FFFF;
// The module's table is of this version; an independent library that is newer knows more pairs of letters.
constexpr int kTableVersion = 14;

bool IsNewerThanTheTable(int codePoint)
{
    UVersionInfo age;
    u_charAge(codePoint, age);
    return age[0] > kTableVersion;
}

std::vector<wchar_t> FoldEverything()
{
    std::vector<wchar_t> folded;
    for (int codePoint = 0; codePoint <= kLastCodePoint; ++codePoint)
        folded.push_back(FoldCase(static_cast<wchar_t>(codePoint)));
    return folded;
}

int Sign(int number)
{
    return (number > 0) - (number < 0);
}
} // namespace

TEST(CaseFolding, FoldsEveryCodePointLikeAnIndependentUnicodeLibrary)
{
    int letters = 0;
    for (int codePoint = 0; codePoint <= kLastCodePoint; ++codePoint)
    {
        if (IsNewerThanTheTable(codePoint))
            continue;
        const auto expected = static_cast<wchar_t>(u_foldCase(codePoint, U_FOLD_CASE_DEFAULT));
        ASSERT_EQ(expected, FoldCase(static_cast<wchar_t>(codePoint))) << std::hex << codePoint;
        letters += expected != static_cast<wchar_t>(codePoint);
    }
    EXPECT_GT(letters, 1300);
}

TEST(CaseFolding, IsTheSameInEveryProcessLocale)
{
    const std::string before = std::setlocale(LC_ALL, nullptr);
    std::vector<std::vector<wchar_t>> results;
    for (const char* locale : {"C", "C.UTF-8", "tr_TR.UTF-8"})
        if (std::setlocale(LC_ALL, locale))
            results.push_back(FoldEverything());
    std::setlocale(LC_ALL, before.c_str());

    ASSERT_GE(results.size(), 2u) << "the two locales that every system has";
    for (const std::vector<wchar_t>& result : results)
        EXPECT_EQ(results.front(), result);
}

TEST(CaseFolding, FoldsTheDotlessAndTheDottedLetterIOfNoLanguageInParticular)
{
    EXPECT_EQ(L'i', FoldCase(L'I'));
    EXPECT_EQ(L'\u0131', FoldCase(L'\u0131'));
    EXPECT_EQ(L'\u0130', FoldCase(L'\u0130'));
}

TEST(CaseFolding, FoldsTheFinalSigmaAndTheSharpCapitalS)
{
    EXPECT_TRUE(EqualIgnoringCase(L"ΣΊΣΥΦΟΣ", L"σίσυφος"));
    EXPECT_TRUE(EqualIgnoringCase(L"STRAẞE", L"straße"));
    EXPECT_FALSE(EqualIgnoringCase(L"STRASSE", L"straße")) << "folding never changes the length";
}

TEST(CaseFolding, LeavesValuesThatAreNoCodePointsAsTheyAre)
{
    for (const wchar_t value : {wchar_t(0x110000), wchar_t(0x7FFFFFFF), wchar_t(-1)})
        EXPECT_EQ(value, FoldCase(value));
}

TEST(CaseFolding, ComparesInTheOrderOfTheFoldedCharacters)
{
    EXPECT_EQ(0, CompareIgnoringCase(L"", L""));
    EXPECT_LT(CompareIgnoringCase(L"", L"a"), 0);
    EXPECT_GT(CompareIgnoringCase(L"ab", L"A"), 0);
    EXPECT_LT(CompareIgnoringCase(L"A", L"b"), 0);
    EXPECT_LT(CompareIgnoringCase(L"a", L"B"), 0);
    EXPECT_LT(CompareIgnoringCase(L"_", L"Z"), 0) << "the sign stands before the small letter";
    EXPECT_GT(CompareIgnoringCase(L"Z", L"_"), 0);
    EXPECT_EQ(0, CompareIgnoringCase(L"ÄÖÜ", L"äöü"));
}

TEST(CaseFolding, ComparisonIsAnOrderAndAgreesWithEqualityAndHash)
{
    std::mt19937 random(20240521);
    const std::wstring letters = L"aAbBéÉßẞσςΣ._kK\u212A";
    std::vector<std::wstring> texts;
    for (int i = 0; i < 120; ++i)
    {
        std::wstring text;
        for (unsigned length = random() % 4; length > 0; --length)
            text += letters[random() % letters.size()];
        texts.push_back(text);
    }
    for (const std::wstring& a : texts)
        for (const std::wstring& b : texts)
        {
            const int order = Sign(CompareIgnoringCase(a, b));
            ASSERT_EQ(order, -Sign(CompareIgnoringCase(b, a)));
            ASSERT_EQ(order == 0, EqualIgnoringCase(a, b));
            if (order == 0)
            {
                ASSERT_EQ(HashIgnoringCase(a), HashIgnoringCase(b));
                ASSERT_EQ(HashIgnoringCase(a, 17), HashIgnoringCase(b, 17));
            }
            for (const std::wstring& c : {texts[0], texts[1], texts[2], texts[3]})
                if (order <= 0 && CompareIgnoringCase(b, c) <= 0)
                {
                    ASSERT_LE(CompareIgnoringCase(a, c), 0);
                }
        }
}

TEST(CaseFolding, TheSeedChainsHashes)
{
    EXPECT_NE(HashIgnoringCase(L"tool", 1), HashIgnoringCase(L"tool", 2));
    EXPECT_NE(HashIgnoringCase(L"tool"), HashIgnoringCase(L"tools"));
}
