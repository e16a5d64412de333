#include "host/text/Unicode.h"

#include <gtest/gtest.h>

using tessel::equalIgnoringCase;
using tessel::foldCase;
using tessel::toUtf8;
using tessel::toWide;

namespace
{
constexpr const wchar_t* kBad = L"\xFFFD";

std::wstring bad(std::size_t count)
{
    return std::wstring(count, kBad[0]);
}
} // namespace

TEST(Utf8, ComesBackAsItWentForEveryLength)
{
    const std::wstring text = L"a\x7F\x80\x7FF\x800\xD7FF\xE000\xFFFF\U00010000\U0010FFFF";
    EXPECT_EQ(toWide(toUtf8(text)), text);
    EXPECT_EQ(toUtf8(L"\x80"), "\xC2\x80");
    EXPECT_EQ(toUtf8(L"\x800"), "\xE0\xA0\x80");
    EXPECT_EQ(toUtf8(L"\U0010FFFF"), "\xF4\x8F\xBF\xBF");
}

TEST(Utf8, ComesBackAsItWentForEveryCodePoint)
{
    std::wstring text;
    for (char32_t code = 1; code <= 0x10FFFF; ++code)
        if (code < 0xD800 || code > 0xDFFF)
            text += static_cast<wchar_t>(code);
    EXPECT_TRUE(toWide(toUtf8(text)) == text);
}

TEST(Utf8, ReplacesBytesThatStartNothing)
{
    EXPECT_EQ(toWide("a\x80z"), L"a" + bad(1) + L"z");
    EXPECT_EQ(toWide("\xFF\xFE"), bad(2));
    EXPECT_EQ(toWide("\xF8\x88\x80\x80\x80"), bad(5));
}

TEST(Utf8, ReplacesASequenceThatIsCutShort)
{
    EXPECT_EQ(toWide("a\xC3"), L"a" + bad(1));
    EXPECT_EQ(toWide("\xE2\x82"), bad(2));
    EXPECT_EQ(toWide("\xE2z"), bad(1) + L"z");
    EXPECT_EQ(toWide("\xF0\x9F\x98z"), bad(3) + L"z");
}

TEST(Utf8, ReplacesOverlongSequences)
{
    EXPECT_EQ(toWide("\xC0\xAF"), bad(2));
    EXPECT_EQ(toWide("\xC1\xBF"), bad(2));
    EXPECT_EQ(toWide("\xE0\x80\xAF"), bad(3));
    EXPECT_EQ(toWide("\xF0\x80\x80\xAF"), bad(4));
}

TEST(Utf8, ReplacesSurrogatesAndWhatIsBeyondTheLastCodePoint)
{
    EXPECT_EQ(toWide("\xED\xA0\x80"), bad(3));
    EXPECT_EQ(toWide("\xF4\x90\x80\x80"), bad(4));
    const wchar_t outside[] = {static_cast<wchar_t>(0xD800), static_cast<wchar_t>(0x110000),
                               static_cast<wchar_t>(0xFFFFFFFF), L'\0'};
    EXPECT_EQ(toUtf8(outside), "\xEF\xBF\xBD\xEF\xBF\xBD\xEF\xBF\xBD");
}

TEST(Utf8, KeepsNulCharacters)
{
    EXPECT_EQ(toWide(std::string_view("a\0b", 3)), std::wstring(L"a\0b", 3));
    EXPECT_EQ(toUtf8(std::wstring_view(L"a\0b", 3)), std::string("a\0b", 3));
}

TEST(CaseFolding, IsRightForLettersOfEveryScript)
{
    EXPECT_EQ(foldCase(L"GRÖSSE"), L"grösse");
    EXPECT_EQ(foldCase(L"ΣΟΦΟΣ"), foldCase(L"σοφος"));
    EXPECT_EQ(foldCase(L"ЖУК"), L"жук");
    EXPECT_EQ(foldCase(L"\U00010400"), L"\U00010428");
    EXPECT_EQ(foldCase(L"\x1E9E"), L"ß");
}

TEST(CaseFolding, NeverChangesTheLength)
{
    EXPECT_EQ(foldCase(L"ßŉǰ").size(), 3u);
    EXPECT_FALSE(equalIgnoringCase(L"straße", L"STRASSE"));
}

TEST(CaseFolding, IsIndependentOfTheLocale)
{
    EXPECT_TRUE(equalIgnoringCase(L"TITLE", L"title"));
    EXPECT_FALSE(equalIgnoringCase(L"\x0130", L"i"));
    EXPECT_FALSE(equalIgnoringCase(L"\x0131", L"I"));
}

TEST(CaseFolding, LeavesWhatIsNoCodePointAlone)
{
    const std::wstring outside = {static_cast<wchar_t>(0xD800), static_cast<wchar_t>(0x110000),
                                  static_cast<wchar_t>(0xFFFFFFFF)};
    EXPECT_EQ(foldCase(outside), outside);
}

TEST(CaseFolding, ComparesTheWholeTexts)
{
    EXPECT_TRUE(equalIgnoringCase(L"", L""));
    EXPECT_TRUE(equalIgnoringCase(L"Büro.LSP", L"BÜRO.lsp"));
    EXPECT_FALSE(equalIgnoringCase(L"tool", L"tools"));
    EXPECT_FALSE(equalIgnoringCase(L"tool", L""));
}
