#include <gtest/gtest.h>

#include <tessel/tsformat.h>

#include <cstdint>
#include <limits>
#include <string>

namespace
{
template <class... Arguments>
std::wstring format(const wchar_t* pattern, const Arguments&... arguments)
{
    const std::size_t length = tsutFormat(nullptr, 0, pattern, arguments...);
    std::wstring text(length + 1, L'?');
    EXPECT_EQ(tsutFormat(text.data(), text.size(), pattern, arguments...), length);
    EXPECT_EQ(text.back(), L'\0');
    text.pop_back();
    return text;
}
} // namespace

TEST(Format, ShowsEveryKindOfArgument)
{
    EXPECT_EQ(format(L"%d %i %u", 1, -2, 3u), L"1 -2 3");
    EXPECT_EQ(format(L"%x %X %o", 255, 255, 8), L"ff FF 10");
    EXPECT_EQ(format(L"%c%c", L'ä', 0x1F600), L"ä\U0001F600");
    EXPECT_EQ(format(L"%s", L"größe"), L"größe");
    EXPECT_EQ(format(L"%f %.1e %g", 1.5, 1000.0, 0.25), L"1.500000 1.0e+03 0.25");
}

TEST(Format, ObeysFlagsWidthAndPrecision)
{
    EXPECT_EQ(format(L"[%5d][%-5d][%05d][%+d][% d]", 42, 42, 42, 42, 42), L"[   42][42   ][00042][+42][ 42]");
    EXPECT_EQ(format(L"[%#x][%#o][%.3d]", 255, 8, 5), L"[0xff][010][005]");
    EXPECT_EQ(format(L"[%6.2f][%-8.3f]", 3.14159, 3.14159), L"[  3.14][3.142   ]");
    EXPECT_EQ(format(L"[%5s][%-5s][%.2s][%4.1s]", L"abc", L"abc", L"abc", L"abc"),
              L"[  abc][abc  ][ab][   a]");
    EXPECT_EQ(format(L"[%3c][%-3c]", L'x', L'x'), L"[  x][x  ]");
}

TEST(Format, TakesLengthModifiersAndTheArgumentsOwnSize)
{
    EXPECT_EQ(format(L"%hhd %hd %ld %lld %jd %zd %td", 1000, 100000, 1L, 1LL << 40, 2, 3, 4),
              L"1000 100000 1 1099511627776 2 3 4");
    EXPECT_EQ(format(L"%ls", L"wide"), L"wide");
}

TEST(Format, WrapsNegativeNumbersAtTheArgumentsOwnSize)
{
    EXPECT_EQ(format(L"%x", static_cast<signed char>(-1)), L"ff");
    EXPECT_EQ(format(L"%x", std::int16_t{-1}), L"ffff");
    EXPECT_EQ(format(L"%u", -1), L"4294967295");
    EXPECT_EQ(format(L"%llx", -1LL), L"ffffffffffffffff");
}

TEST(Format, ShowsTheExtremesOfEveryNumber)
{
    EXPECT_EQ(format(L"%d", std::numeric_limits<long long>::min()), L"-9223372036854775808");
    EXPECT_EQ(format(L"%d", std::numeric_limits<unsigned long long>::max()), L"18446744073709551615");
    EXPECT_EQ(format(L"%f", std::numeric_limits<double>::max()).size(), 309u + 7u);
    EXPECT_EQ(format(L"%f", std::numeric_limits<double>::infinity()), L"inf");
}

TEST(Format, PrintsTwoPerCentSignsAsOne)
{
    EXPECT_EQ(format(L"100%%"), L"100%");
    EXPECT_EQ(format(L"%%%d%%", 5), L"%5%");
    EXPECT_EQ(format(L"%%d", 5), L"%d");
}

TEST(Format, PrintsAConversionWithoutAnArgumentAsItStands)
{
    EXPECT_EQ(format(L"%s and %d"), L"%s and %d");
    EXPECT_EQ(format(L"%d of %d", 3), L"3 of %d");
    EXPECT_EQ(format(L"%-5.3s|%ld"), L"%-5.3s|%ld");
}

TEST(Format, PrintsAConversionOfAnotherKindAsItStandsAndKeepsItsArgument)
{
    EXPECT_EQ(format(L"%s", 5), L"%s");
    EXPECT_EQ(format(L"%d", L"text"), L"%d");
    EXPECT_EQ(format(L"%d", 1.5), L"%d");
    EXPECT_EQ(format(L"%f", 1), L"%f");
    EXPECT_EQ(format(L"%c", L"text"), L"%c");
    EXPECT_EQ(format(L"%d then %s", L"text"), L"%d then text");
}

TEST(Format, NeverObeysAConversionThatWrites)
{
    EXPECT_EQ(format(L"%n"), L"%n");
    EXPECT_EQ(format(L"%n%hhn%lln", 1, 2, 3), L"%n%hhn%lln");
}

TEST(Format, PrintsWhatIsNoConversionAsItStands)
{
    EXPECT_EQ(format(L"%"), L"%");
    EXPECT_EQ(format(L"50% of %"), L"50% of %");
    EXPECT_EQ(format(L"%*d %$ %1$s %p %a %\x00E4", 7, 7, L"x"), L"%*d %$ %1$s %p %a %\x00E4");
    EXPECT_EQ(format(L"%5"), L"%5");
    EXPECT_EQ(format(L"%l"), L"%l");
    EXPECT_EQ(format(L"%.-3d", 7), L"%.-3d");
}

TEST(Format, LooksForAConversionAfterOneThatIsNone)
{
    EXPECT_EQ(format(L"%5%d", 7), L"%57");
    EXPECT_EQ(format(L"%-%s", L"x"), L"%-x");
}

TEST(Format, PrintsFileNamesThatHoldPerCentSigns)
{
    EXPECT_EQ(format(L"/tmp/100%.lsp"), L"/tmp/100%.lsp");
    EXPECT_EQ(format(L"/tmp/100%s/50%d.lsp"), L"/tmp/100%s/50%d.lsp");
    EXPECT_EQ(format(L"\"%s\" is loaded", L"/tmp/%s%n%d.lsp"), L"\"/tmp/%s%n%d.lsp\" is loaded");
}

TEST(Format, PadsHugeWidthsToALimit)
{
    EXPECT_EQ(format(L"%999999999999d", 7).size(), 1000u);
    EXPECT_EQ(format(L"%2147483648s", L"x").size(), 1000u);
    EXPECT_EQ(format(L"%.999999999999d", 7).size(), 1000u);
    EXPECT_EQ(format(L"%1000.1000f", std::numeric_limits<double>::max()).size(), 309u + 1001u);
}

TEST(Format, NeverCutsATextByALargePrecision)
{
    const std::wstring text(4000, L'x');
    EXPECT_TRUE(format(L"%.4000s", text.c_str()) == text);
    EXPECT_EQ(format(L"%.3999s", text.c_str()).size(), 3999u);
    EXPECT_TRUE(format(L"%.99999999999999999999s", text.c_str()) == text);
}

TEST(Format, PrintsTextsLongerThanAnyWidth)
{
    const std::wstring text(100'000, L'ß');
    EXPECT_TRUE(format(L"<%10s>", text.c_str()) == L"<" + text + L">");
}

TEST(Format, CutsToTheBufferAndTerminates)
{
    wchar_t buffer[] = L"????????";
    EXPECT_EQ(tsutFormat(buffer, 4, L"%s", L"abcdef"), 6u);
    EXPECT_STREQ(buffer, L"abc");
    EXPECT_EQ(buffer[4], L'?');
    EXPECT_EQ(tsutFormat(buffer, 1, L"%s", L"abcdef"), 6u);
    EXPECT_STREQ(buffer, L"");
    EXPECT_EQ(tsutFormat(buffer, 0, L"xyz"), 3u);
    EXPECT_STREQ(buffer, L"");
}

TEST(Format, TakesNullForNothing)
{
    EXPECT_EQ(format(nullptr), L"");
    EXPECT_EQ(format(L"%s", static_cast<const wchar_t*>(nullptr)), L"(null)");
    EXPECT_EQ(format(L""), L"");
}
