#include "modrig/base/CStdStr.h"

#include <clocale>
#include <limits>
#include <string>

#include "modrig/messages/MessageIds.h"
#include "tests/support/ModuleTest.h"

namespace
{
class StdStr : public ModuleTest
{
};

// What a caller passes where the string is text number `id`.
const wchar_t* IdAsPointer(std::uintptr_t id)
{
    return reinterpret_cast<const wchar_t*>(id);
}

std::wstring Formatted(const wchar_t* format, const auto&... arguments)
{
    CStdStr text;
    text.Fmt(format, arguments...);
    return text.Text();
}
} // namespace

TEST_F(StdStr, IsEmptyFromNothingFromNullAndFromAnEmptyText)
{
    EXPECT_TRUE(CStdStr().IsEmpty());
    EXPECT_TRUE(CStdStr(static_cast<const wchar_t*>(nullptr)).IsEmpty());
    EXPECT_TRUE(CStdStr(L"").IsEmpty());
    EXPECT_STREQ(L"", CStdStr().c_str());
    EXPECT_TRUE(host().journal.entries().empty()) << "none of them is a text of the resource module";
}

TEST_F(StdStr, CountsCharactersAndNotBytes)
{
    const CStdStr text(L"ä€\U0001F600");
    EXPECT_EQ(3u, text.Text().size());
    EXPECT_EQ(L"€", text.Mid(1, 1).Text());
}

TEST_F(StdStr, LoadsTheTextWhenMadeFromAnIdInsteadOfAPointer)
{
    host().resources.setText(kResourceModuleName, 1, L"first");
    host().resources.setText(kResourceModuleName, 65535, L"last");
    EXPECT_EQ(L"first", CStdStr(IdAsPointer(1)).Text());
    EXPECT_EQ(L"last", CStdStr(IdAsPointer(65535)).Text());
}

// Nothing lies at that address, so that reading a text there ends the program; loading one would not.
TEST_F(StdStr, TakesTheFirstAddressAfterTheIdsForAText)
{
    EXPECT_DEATH(CStdStr(IdAsPointer(65536)), "");
}

TEST_F(StdStr, IsEmptyWhenMadeFromAnIdThatIsMissing)
{
    EXPECT_TRUE(CStdStr(IdAsPointer(4711)).IsEmpty());
}

TEST_F(StdStr, ComparesWithoutCaseInAnyScript)
{
    EXPECT_TRUE(CStdStr(L"TÖÖL.LSP").EqualsNoCase(L"tööl.lsp"));
    EXPECT_TRUE(CStdStr(L"ΣΊΣΥΦΟΣ").EqualsNoCase(L"σίσυφος"));
    EXPECT_TRUE(CStdStr(L"ЧЕРТЁЖ").EqualsNoCase(L"чертёж"));
    EXPECT_FALSE(CStdStr(L"tool").EqualsNoCase(L"tool "));
    EXPECT_EQ(0, CStdStr(L"Ä").CompareNoCase(L"ä"));
    EXPECT_LT(CStdStr(L"A").CompareNoCase(L"b"), 0);
    EXPECT_GT(CStdStr(L"b").CompareNoCase(L"A"), 0);
}

TEST_F(StdStr, ComparesTheSameInEveryProcessLocale)
{
    const std::string before = std::setlocale(LC_ALL, nullptr);
    for (const char* locale : {"C", "C.UTF-8"})
    {
        ASSERT_TRUE(std::setlocale(LC_ALL, locale));
        EXPECT_TRUE(CStdStr(L"TÖÖL").EqualsNoCase(L"tööl")) << locale;
        EXPECT_TRUE(CStdStr(L"FILE").EqualsNoCase(L"file")) << locale;
    }
    std::setlocale(LC_ALL, before.c_str());
}

TEST_F(StdStr, EqualsToTheLetterOnlyWithTheOperator)
{
    EXPECT_TRUE(CStdStr(L"tool") == CStdStr(L"tool"));
    EXPECT_FALSE(CStdStr(L"tool") == CStdStr(L"Tool"));
}

TEST_F(StdStr, LeftGivesTheFirstCharactersOrAllThereAre)
{
    const CStdStr text(L"tool");
    EXPECT_EQ(L"", text.Left(0).Text());
    EXPECT_EQ(L"to", text.Left(2).Text());
    EXPECT_EQ(L"tool", text.Left(4).Text());
    EXPECT_EQ(L"tool", text.Left(99).Text());
}

TEST_F(StdStr, MidGivesTheRestOrAPartAndNothingBeyondTheEnd)
{
    const CStdStr text(L"tool");
    EXPECT_EQ(L"tool", text.Mid(0).Text());
    EXPECT_EQ(L"ol", text.Mid(2).Text());
    EXPECT_EQ(L"o", text.Mid(1, 1).Text());
    EXPECT_EQ(L"ool", text.Mid(1, 99).Text());
    EXPECT_EQ(L"", text.Mid(1, 0).Text());
    EXPECT_EQ(L"", text.Mid(4).Text());
    EXPECT_EQ(L"", text.Mid(5).Text());
    EXPECT_EQ(L"", text.Mid(std::numeric_limits<std::size_t>::max(), 1).Text());
}

TEST_F(StdStr, TrimsWhiteSpaceFromEitherEnd)
{
    EXPECT_EQ(L"a b \t", CStdStr(L" \t\r\n\f\va b \t").TrimLeft().Text());
    EXPECT_EQ(L" \ta b", CStdStr(L" \ta b \t\r\n\f\v").TrimRight().Text());
    EXPECT_EQ(L"a", CStdStr(L"  a  ").TrimLeft().TrimRight().Text());
    EXPECT_EQ(L"", CStdStr(L" \t ").TrimLeft().Text());
    EXPECT_EQ(L"", CStdStr(L" \t ").TrimRight().Text());
    EXPECT_EQ(L"", CStdStr().TrimLeft().TrimRight().Text());
}

TEST_F(StdStr, TrimsOneCharacterFromEitherEnd)
{
    EXPECT_EQ(L"a*b*", CStdStr(L"**a*b*").TrimLeft(L'*').Text());
    EXPECT_EQ(L"*a*b", CStdStr(L"*a*b**").TrimRight(L'*').Text());
    EXPECT_EQ(L"", CStdStr(L"***").TrimLeft(L'*').Text());
    EXPECT_EQ(L"", CStdStr(L"***").TrimRight(L'*').Text());
    EXPECT_EQ(L" a ", CStdStr(L" a ").TrimLeft(L'*').TrimRight(L'*').Text());
}

TEST_F(StdStr, GivesTheTextAfterTheLastDotOfTheWholePath)
{
    EXPECT_EQ(L"lsp", CStdStr(L"/a.b/tool.old.lsp").AfterLastDot().Text());
    EXPECT_EQ(L"old/tool", CStdStr(L"/dir.old/tool").AfterLastDot().Text());
    EXPECT_EQ(L"", CStdStr(L"tool.").AfterLastDot().Text());
    EXPECT_EQ(L"", CStdStr(L"tool").AfterLastDot().Text());
    EXPECT_TRUE(CStdStr(L"tool.").HasDot());
    EXPECT_FALSE(CStdStr(L"tool").HasDot());
    EXPECT_FALSE(CStdStr().HasDot());
}

TEST_F(StdStr, JoinsTexts)
{
    CStdStr text(L"a");
    text += CStdStr(L"b");
    EXPECT_EQ(L"abc", (text + CStdStr(L"c")).Text());
    EXPECT_EQ(L"ab", text.Text());
    text += text;
    EXPECT_EQ(L"abab", text.Text());
}

TEST_F(StdStr, LoadsFromTheCurrentResourceModuleWhenNoneIsNamed)
{
    CStdStr text(L"before");
    EXPECT_TRUE(text.Load(ModrigMessages::kLispPrompt));
    EXPECT_EQ(L"Command:", text.Text());
}

TEST_F(StdStr, LoadsFromTheModuleThatIsNamed)
{
    host().resources.addModule(L"other.dll", {{15, L"other"}});
    CStdStr text;
    EXPECT_TRUE(text.Load(ModrigMessages::kLispPrompt, host().resources.load(L"other.dll")));
    EXPECT_EQ(L"other", text.Text());
}

TEST_F(StdStr, KeepsItsValueWhenTheTextToLoadIsMissingOrEmpty)
{
    host().resources.setText(kResourceModuleName, 5000, L"");
    CStdStr text(L"before");
    EXPECT_FALSE(text.Load(4711));
    EXPECT_FALSE(text.Load(5000));
    host().resources.current = nullptr;
    EXPECT_FALSE(text.Load(ModrigMessages::kLispPrompt));
    EXPECT_EQ(L"before", text.Text());
}

TEST_F(StdStr, LoadsATextWholeHoweverLongItIs)
{
    for (const std::size_t length : {1u, 4094u, 4095u, 4096u, 8191u, 8192u, 65535u, 100000u})
    {
        const std::wstring whole = std::wstring(length - 1, L'x') + L'.';
        host().resources.setText(kResourceModuleName, 5000, whole);
        CStdStr text;
        EXPECT_TRUE(text.Load(5000)) << length;
        EXPECT_EQ(whole, text.Text()) << length;
    }
}

TEST_F(StdStr, FetchesATextAgainOnlyWhenItFillsTheRoom)
{
    const std::pair<std::size_t, std::size_t> fetches[] = {
        {1, 1}, {4094, 1}, {4095, 2}, {8190, 2}, {8191, 3}};
    for (const auto& [length, expected] : fetches)
    {
        host().resources.setText(kResourceModuleName, 5000, std::wstring(length, L'x'));
        host().journal.clear();
        CStdStr text;
        EXPECT_TRUE(text.Load(5000));
        EXPECT_EQ(expected, host().journal.count(L"loadStringFromWin32ResourceDLL")) << length;
    }
}

TEST_F(StdStr, LoadsATextThatIsNotEmptyWhateverItsFirstCharacter)
{
    const std::wstring whole(L"\0after", 6);
    host().resources.setText(kResourceModuleName, 5000, whole);
    CStdStr text(L"before");
    EXPECT_TRUE(text.Load(5000));
    EXPECT_EQ(whole, text.Text());
    host().resources.setText(kResourceModuleName, 5000, std::wstring(1, L'\0'));
    EXPECT_TRUE(text.Load(5000));
    EXPECT_EQ(1u, text.Text().size());
}

TEST_F(StdStr, FormatsByTheTextOfAnId)
{
    CStdStr text;
    EXPECT_TRUE(text.Format(ModrigMessages::kOneUnloaded, L"tool.lsp"));
    EXPECT_EQ(Message(ModrigMessages::kOneUnloaded, L"tool.lsp"), text.Text());
}

TEST_F(StdStr, FormatsNothingWhenTheIdIsMissing)
{
    CStdStr text(L"before");
    EXPECT_FALSE(text.Format(4711, L"tool.lsp"));
    EXPECT_EQ(L"before", text.Text());
}

TEST_F(StdStr, FormatsNumbersTextsAndCharacters)
{
    EXPECT_EQ(L"3History", Formatted(L"%dHistory", 3L));
    EXPECT_EQ(L"18446744073709551615", Formatted(L"%d", std::numeric_limits<std::size_t>::max()));
    EXPECT_EQ(L"-7|  7|007|ff", Formatted(L"%d|%3d|%03d|%x", -7, 7, 7, 255));
    EXPECT_EQ(L"[  ab][ab  ][a]", Formatted(L"[%4s][%-4s][%.1s]", L"ab", L"ab", L"ab"));
    EXPECT_EQ(L"€ 1.50 100%", Formatted(L"%c %.2f 100%%", L'€', 1.5));
}

TEST_F(StdStr, FormatsAConversionThatDoesNotFitItsArgumentAsItStands)
{
    EXPECT_EQ(L"%s", Formatted(L"%s"));
    EXPECT_EQ(L"a %s", Formatted(L"%s %s", L"a"));
    EXPECT_EQ(L"%s", Formatted(L"%s", 7));
    EXPECT_EQ(L"%d", Formatted(L"%d", L"seven"));
    EXPECT_EQ(L"%n%", Formatted(L"%n%", L"a"));
}

TEST_F(StdStr, FormatsAtMostTheLengthOfTheFormatPlus1023Characters)
{
    const std::wstring argument(5000, L'x');
    EXPECT_EQ(2u + 1023u, Formatted(L"%s", argument.c_str()).size());
    EXPECT_EQ(6u + 1023u, Formatted(L"ab%scd", argument.c_str()).size());
    EXPECT_EQ(L"ab", Formatted(L"ab%scd", argument.c_str()).substr(0, 2));
}

TEST_F(StdStr, FormatsATextThatFitsExactlyWithoutCutting)
{
    const std::wstring argument(1023 + 2, L'x');
    EXPECT_EQ(argument, Formatted(L"%s", argument.c_str()));
    const std::wstring format(3000, L'f');
    EXPECT_EQ(format, Formatted(format.c_str()));
}

TEST_F(StdStr, FormatsWithItsOwnTextAsFormatAndAsArgument)
{
    CStdStr text(L"<%s>");
    text.Fmt(text.c_str(), text.c_str());
    EXPECT_EQ(L"<<%s>>", text.Text());
}
