#include "host/text/Unicode.h"

#include <gtest/gtest.h>

using tessel::equalIgnoringCase;
using tessel::foldCase;
using tessel::foldedUtf8;
using tessel::toUtf8;
using tessel::toWide;
using tessel::withReadableBytes;

namespace
{
// The characters that the bytes stand as.
std::wstring asBytes(std::string_view bytes)
{
    std::wstring text;
    for (const char byte : bytes)
        text += static_cast<wchar_t>(0x10FE00 + static_cast<unsigned char>(byte));
    return text;
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
        if ((code < 0xD800 || code > 0xDFFF) && (code < 0x10FE80 || code > 0x10FEFF))
            text += static_cast<wchar_t>(code);
    EXPECT_TRUE(toWide(toUtf8(text)) == text);
}

TEST(Utf8, ComesBackAsItWentWhereverTheFirstCharacterBeyondAsciiStands)
{
    for (std::size_t place = 0; place < 40; ++place)
    {
        std::wstring text(40, L'a');
        text[place] = L'ü';
        EXPECT_EQ(toWide(toUtf8(text)), text) << place;
        EXPECT_EQ(toUtf8(text).substr(place, 2), "\xC3\xBC") << place;
    }
}

// Names of files, which may be any bytes.
TEST(Utf8, KeepsBytesThatStartNothing)
{
    EXPECT_EQ(toWide("a\x80z"), L"a" + asBytes("\x80") + L"z");
    EXPECT_EQ(toWide("\xFF\xFE"), asBytes("\xFF\xFE"));
    EXPECT_EQ(toWide("\xF8\x88\x80\x80\x80"), asBytes("\xF8\x88\x80\x80\x80"));
}

TEST(Utf8, KeepsTheBytesOfASequenceThatIsCutShort)
{
    EXPECT_EQ(toWide("a\xC3"), L"a" + asBytes("\xC3"));
    EXPECT_EQ(toWide("\xE2\x82"), asBytes("\xE2\x82"));
    EXPECT_EQ(toWide("\xE2z"), asBytes("\xE2") + L"z");
    EXPECT_EQ(toWide("\xF0\x9F\x98z"), asBytes("\xF0\x9F\x98") + L"z");
}

TEST(Utf8, KeepsTheBytesOfOverlongSequences)
{
    for (const char* bytes : {"\xC0\xAF", "\xC1\xBF", "\xE0\x80\xAF", "\xF0\x80\x80\xAF"})
        EXPECT_EQ(toWide(bytes), asBytes(bytes));
}

TEST(Utf8, KeepsTheBytesOfSurrogatesAndOfWhatIsBeyondTheLastCodePoint)
{
    for (const char* bytes : {"\xED\xA0\x80", "\xF4\x90\x80\x80"})
        EXPECT_EQ(toWide(bytes), asBytes(bytes));
}

TEST(Utf8, GivesEveryByteBack)
{
    for (int byte = 1; byte <= 0xFF; ++byte)
    {
        const std::string name = std::string("a") + static_cast<char>(byte) + "z";
        EXPECT_EQ(toUtf8(toWide(name)), name);
    }
}

TEST(Utf8, GivesTheCharactersBackThatBytesStandAs)
{
    const std::string name = "\xF4\x8F\xBA\x80 \xF4\x8F\xBB\xBF"; // U+10FE80, U+10FEFF
    EXPECT_EQ(toWide(name), asBytes("\xF4\x8F\xBA\x80") + L" " + asBytes("\xF4\x8F\xBB\xBF"));
    EXPECT_EQ(toUtf8(toWide(name)), name);
}

TEST(Utf8, ReplacesWhatIsNoCharacter)
{
    const wchar_t outside[] = {static_cast<wchar_t>(0xD800), static_cast<wchar_t>(0x110000),
                               static_cast<wchar_t>(0xFFFFFFFF), L'\0'};
    EXPECT_EQ(toUtf8(outside), "\xEF\xBF\xBD\xEF\xBF\xBD\xEF\xBF\xBD");
}

TEST(Utf8, WritesBytesAsEscapesWhereAPersonReads)
{
    EXPECT_EQ(withReadableBytes(toWide("bad\xFF\x80 gr\xC3\xBC\n")), L"bad\\xFF\\x80 gr\u00FC\n");
    EXPECT_EQ(withReadableBytes(L"\U0010FE7F\U0010FF00"), L"\U0010FE7F\U0010FF00");
}

TEST(Utf8, KeepsNulCharacters)
{
    EXPECT_EQ(toWide(std::string_view("a\0b", 3)), std::wstring(L"a\0b", 3));
    EXPECT_EQ(toUtf8(std::wstring_view(L"a\0b", 3)), std::string("a\0b", 3));
}

TEST(Utf16, JoinsTheHalvesOfCharactersOutsideTheBasicPlane)
{
    EXPECT_EQ(toWide(u"a\xD800\xDC00z\xDBFF\xDFFF"), L"a\U00010000z\U0010FFFF");
    EXPECT_EQ(toWide(u"\xD7FF\xE000\xFFFF"), L"\xD7FF\xE000\xFFFF");
    EXPECT_EQ(toWide(std::u16string_view(u"a\0b", 3)), std::wstring(L"a\0b", 3));
}

TEST(Utf16, ReplacesHalvesThatStandAlone)
{
    EXPECT_EQ(toWide(u"a\xD83D"), L"a\xFFFD");
    EXPECT_EQ(toWide(u"\xD83Dz"), L"\xFFFDz");
    EXPECT_EQ(toWide(u"\xDE00\xD83D\xDE00"), L"\xFFFD\U0001F600");
    EXPECT_EQ(toWide(u"\xD83D\xD83D\xDE00"), L"\xFFFD\U0001F600");
}

TEST(CaseFolding, IsRightForLettersOfEveryScript)
{
    EXPECT_EQ(foldCase(L"GRÖSSE"), L"grösse");
    EXPECT_EQ(foldCase(L"ΣΟΦΟΣ"), foldCase(L"σοφος"));
    EXPECT_EQ(foldCase(L"ЖУК"), L"жук");
    EXPECT_EQ(foldCase(L"\U00010400"), L"\U00010428");
    EXPECT_EQ(foldCase(L"\x1E9E"), L"ß");
}

TEST(CaseFolding, IsTheSameInUtf8)
{
    for (const wchar_t* text : {L"", L"@AMZ[`az{", L"12History", L"ÄÖ 12History", L"12History \U00010400"})
        EXPECT_EQ(foldedUtf8(text), toUtf8(foldCase(text)));
    EXPECT_EQ(foldedUtf8(L"@AMZ[`az{"), "@amz[`az{");
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
