#include "host/ui/platform/gnustep/MnemonicLetters.h"

#include <gmock/gmock.h>

#include <clocale>

using tessel::windowing::chooseMnemonics;
using tessel::windowing::isMnemonic;
using testing::ElementsAre;

namespace
{
// The letters, with a blank where there is none.
std::wstring lettersOf(const std::vector<std::wstring>& texts)
{
    std::wstring letters;
    const auto places = chooseMnemonics(texts);
    for (std::size_t index = 0; index < texts.size(); ++index)
        letters += places[index] ? texts[index][*places[index]] : L' ';
    return letters;
}
} // namespace

TEST(MnemonicLetters, AreFirstLettersWhereTheyCan)
{
    EXPECT_EQ(lettersOf({L"Up", L"Home", L"Load"}), L"UHL");
}

TEST(MnemonicLetters, AreThoseOfFurtherWordsBeforeOthers)
{
    EXPECT_EQ(lettersOf({L"Load", L"Loaded Applications"}), L"LA");
    EXPECT_EQ(lettersOf({L"Load", L"Loaded, of kind"}), L"Lo");
}

TEST(MnemonicLetters, OfWhatComesLaterAreNotTakenFromFirstLetters)
{
    EXPECT_EQ(lettersOf({L"Hide", L"Hill", L"In"}), L"HlI");
}

TEST(MnemonicLetters, DifferWithoutRegardToCase)
{
    EXPECT_EQ(lettersOf({L"as", L"AS"}), L"aS");
    EXPECT_TRUE(isMnemonic(L'A', L'a'));
    EXPECT_TRUE(isMnemonic(L'a', L'A'));
    EXPECT_FALSE(isMnemonic(L'a', L'b'));
}

TEST(MnemonicLetters, AreMovedWhereAnotherTextHasNoOtherLetter)
{
    EXPECT_THAT(chooseMnemonics({L"ab", L"bc", L"a"}), ElementsAre(1U, 1U, 0U));
}

TEST(MnemonicLetters, AreNeverThoseThatAreTaken)
{
    EXPECT_THAT(chooseMnemonics({L"Load", L"oa"}, L"lA"), ElementsAre(3U, 0U));
    EXPECT_THAT(chooseMnemonics({L"al"}, L"lA"), ElementsAre(std::nullopt));
}

TEST(MnemonicLetters, AreNoneWhereThereAreNotEnough)
{
    EXPECT_EQ(lettersOf({L"a", L"a", L"", L"12…"}), L"a   ");
}

TEST(MnemonicLetters, AreOfAnyScript)
{
    std::setlocale(LC_CTYPE, "C.UTF-8");
    EXPECT_EQ(lettersOf({L"Öffnen", L"öde"}), L"Öd");
}
