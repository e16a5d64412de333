#include <tessel/tsformat.h>
#include <wincompat/winfile.h>

#include <limits>

#include "tests/contract/ContractTest.h"

namespace
{
constexpr std::size_t kTextSize = 256;

class TextContract : public ContractTest
{
protected:
    template <class... Arguments>
    static std::wstring format(const wchar_t* text, const Arguments&... arguments)
    {
        wchar_t buffer[kTextSize] = {};
        const std::size_t length = tsutFormat(buffer, kTextSize, text, arguments...);
        EXPECT_EQ(length, std::wcslen(buffer));
        return buffer;
    }

    static std::wstring number(int value, int base)
    {
        wchar_t buffer[33] = {};
        EXPECT_EQ(ms_itow(value, buffer, base), buffer);
        return buffer;
    }
};

TEST_F(TextContract, FormatsNumbersAndTexts)
{
    EXPECT_EQ(format(L"%d files, %s", 3, L"\u00FC\U0001F600.lsp"), L"3 files, \u00FC\U0001F600.lsp");
    EXPECT_EQ(format(L"%i %u %x %X %o", -1, 7u, 255, 255, 8), L"-1 7 ff FF 10");
    EXPECT_EQ(format(L"%5d|%-5d|%05d|%+d", 42, 42, 42, 42), L"   42|42   |00042|+42");
    EXPECT_EQ(format(L"%.2f %e %g", 1.5, 1.0, 0.25), L"1.50 1.000000e+00 0.25");
    EXPECT_EQ(format(L"%6s|%-6s|%.2s", L"abc", L"abc", L"abc"), L"   abc|abc   |ab");
    EXPECT_EQ(format(L"%c%%", L'\u00E9'), L"\u00E9%");
}

TEST_F(TextContract, TakesTheSizeOfANumberFromTheNumber)
{
    EXPECT_EQ(format(L"%d", std::numeric_limits<long long>::min()), L"-9223372036854775808");
    EXPECT_EQ(format(L"%hd %lld", 100000, 5), L"100000 5");
    EXPECT_EQ(format(L"%x", -1), L"ffffffff");
}

TEST_F(TextContract, PrintsAMisfitAsItStands)
{
    EXPECT_EQ(format(L"%s and %d"), L"%s and %d");
    EXPECT_EQ(format(L"%d", L"text"), L"%d");
    EXPECT_EQ(format(L"%s", 5), L"%s");
    EXPECT_EQ(format(L"%d %s", L"text"), L"%d text"); // a misfit takes no argument away
    EXPECT_EQ(format(L"100%.lsp"), L"100%.lsp");
    EXPECT_EQ(format(L"%n%q%"), L"%n%q%");
}

TEST_F(TextContract, PrintsANullTextAsAWord)
{
    EXPECT_EQ(format(L"%s", static_cast<const wchar_t*>(nullptr)), L"(null)");
}

TEST_F(TextContract, CutsToTheBufferAndAnswersTheWholeLength)
{
    wchar_t buffer[6] = L"?????";
    EXPECT_EQ(tsutFormat(buffer, 4, L"%s", L"abcdef"), 6u);
    EXPECT_STREQ(buffer, L"abc");
    EXPECT_EQ(buffer[4], L'?');
    EXPECT_EQ(tsutFormat(nullptr, 0, L"%s", L"abcdef"), 6u);
}

TEST_F(TextContract, PrintsOnTheCommandLine)
{
    EXPECT_EQ(tsutPrintf(L"<%d %s>\n", 1, L"\u00FC"), 6);
    EXPECT_TRUE(contains(host->seen(), L"<1 \u00FC>\n"));
}

TEST_F(TextContract, PrintsATextThatIsItsOwnFormat)
{
    EXPECT_EQ(tsutPrintf(L"<50%s off%n.lsp>"), 16);
    EXPECT_TRUE(contains(host->seen(), L"<50%s off%n.lsp>"));
}

TEST_F(TextContract, PrintsATextOfAnyLength)
{
    const std::wstring text(20000, L'\u00FC');
    EXPECT_EQ(tsutPrintf(L"<%s>", text.c_str()), 20002);
    EXPECT_TRUE(contains(host->seen(), L"<" + text + L">"));
}

TEST_F(TextContract, WritesNumbersInEveryBase)
{
    EXPECT_EQ(number(0, 10), L"0");
    EXPECT_EQ(number(-12, 10), L"-12");
    EXPECT_EQ(number(std::numeric_limits<int>::min(), 10), L"-2147483648");
    EXPECT_EQ(number(255, 16), L"ff");
    EXPECT_EQ(number(-1, 16), L"ffffffff");
    EXPECT_EQ(number(-1, 2), std::wstring(32, L'1'));
    EXPECT_EQ(number(35, 36), L"z");
}
} // namespace
