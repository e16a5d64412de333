#include "host/registry/RegistryText.h"

#include <gmock/gmock.h>

#include "host/text/Unicode.h"

using namespace tessel;
using testing::HasSubstr;
using testing::StartsWith;
using Change = RegistryChange;
using Kind = RegistryChange::Kind;

namespace
{
const std::string kBegin = "Windows Registry Editor Version 5.00\r\n\r\n";

std::vector<Change> read(const std::string& text)
{
    auto changes = readRegistryText(kBegin + text);
    EXPECT_TRUE(changes) << toUtf8(changes.sentence());
    return changes ? *changes : std::vector<Change>();
}

std::string whyNot(const std::string& bytes)
{
    const auto changes = readRegistryText(bytes);
    EXPECT_FALSE(changes) << bytes;
    return toUtf8(changes.sentence());
}

std::string written(const std::vector<Change>& changes, RegistryTextForm form = RegistryTextForm::kUtf8)
{
    const auto text = writeRegistryText(changes, form);
    EXPECT_TRUE(text) << toUtf8(text.sentence());
    return text ? *text : "";
}

// Where a change stands is no part of what it asks for.
std::vector<Change> withoutLines(std::vector<Change> changes)
{
    for (Change& change : changes)
        change.line = 0;
    return changes;
}

const std::vector<Change> kOfEachKind = {
    {Kind::kMakeKey, L"", L"", L""},
    {Kind::kMakeKey, L"Software\\A [1]", L"", L""},
    {Kind::kSetValue, L"Software\\A [1]", L"", L"unnamed"},
    {Kind::kSetValue, L"Software\\A [1]", L"a \"name\" \\ = ;", L"C:\\path \"x\" ; no note"},
    {Kind::kSetValue, L"Software\\A [1]", L"empty", L""},
    {Kind::kSetValue, L"Software\\A [1]", L"lines",
     L"one\r\ntwo\n\tthree\x7F and more that goes over a line"},
    {Kind::kSetValue, L"Software\\A [1]", L"name\nof two lines", L"\x1F600 \x10FEFF \xFC"},
    {Kind::kRemoveValue, L"Software\\A [1]", L"gone", L""},
    {Kind::kRemoveValue, L"Software\\A [1]", L"", L""},
    {Kind::kRemoveKey, L"Software\\B", L"", L""},
};
} // namespace

TEST(RegistryText, ReadsKeysAndValues)
{
    EXPECT_THAT(
        read("[HKEY_CURRENT_USER\\Software\\Tessel]\r\n\"name\"=\"text\"\r\n@=\"unnamed\"\r\n\r\n[hkcu]\r\n"),
        testing::ElementsAre(Change{Kind::kMakeKey, L"Software\\Tessel", L"", L"", 3},
                             Change{Kind::kSetValue, L"Software\\Tessel", L"name", L"text", 4},
                             Change{Kind::kSetValue, L"Software\\Tessel", L"", L"unnamed", 5},
                             Change{Kind::kMakeKey, L"", L"", L"", 7}));
}

TEST(RegistryText, ReadsWhatIsToGo)
{
    EXPECT_THAT(read("[HKCU\\A]\n\"x\"=-\n@ = - ; a note\n[-HKCU\\B]"),
                testing::ElementsAre(Change{Kind::kMakeKey, L"A", L"", L"", 3},
                                     Change{Kind::kRemoveValue, L"A", L"x", L"", 4},
                                     Change{Kind::kRemoveValue, L"A", L"", L"", 5},
                                     Change{Kind::kRemoveKey, L"B", L"", L"", 6}));
}

TEST(RegistryText, PassesOverNotesAndBlanks)
{
    EXPECT_EQ(read("; [HKCU\\No]\n \t \n  [HKCU\\A] \n\t\"x\" = \"y\" \t;\"z\"=\"1\"\n;").size(), 2U);
    EXPECT_TRUE(readRegistryText("Windows Registry Editor Version 5.00 \t"));
}

TEST(RegistryText, ReadsTextsByTheirUnits)
{
    const auto changes =
        read("[HKCU\\A]\r\n\"x\"=hex(1):61,00, 3D,d8,\\\r\n  00,de,\\\n00,00\r\n\"y\"=hex(1):\r\n"
             "\"z\"=hex(1):62,00");
    ASSERT_EQ(changes.size(), 4U);
    EXPECT_EQ(changes[1].data, L"a\x1F600");
    EXPECT_EQ(changes[2].data, L"");
    EXPECT_EQ(changes[3].data, L"b");
    EXPECT_EQ(changes[3].line, 8U);
}

TEST(RegistryText, ReadsEveryEncodingThatSuchFilesHave)
{
    const std::string utf8 = kBegin + "[HKCU\\\xC3\xBC]";
    const std::u16string units = toUtf16(toWide(utf8));
    std::string lowFirst = "\xFF\xFE";
    std::string highFirst = "\xFE\xFF";
    for (const char16_t unit : units)
    {
        lowFirst += {static_cast<char>(unit & 0xFF), static_cast<char>(unit >> 8)};
        highFirst += {static_cast<char>(unit >> 8), static_cast<char>(unit & 0xFF)};
    }
    for (const std::string& bytes : {utf8, "\xEF\xBB\xBF" + utf8, lowFirst, highFirst})
    {
        const auto changes = readRegistryText(bytes);
        ASSERT_TRUE(changes) << toUtf8(changes.sentence());
        EXPECT_THAT(*changes, testing::ElementsAre(Change{Kind::kMakeKey, L"\xFC", L"", L"", 3}));
    }
    lowFirst.pop_back();
    EXPECT_EQ(whyNot(lowFirst), "it ends in the middle of a character");
}

TEST(RegistryText, NamesTheLineOfWhatIsNotUnderstood)
{
    EXPECT_EQ(whyNot(""), "in line 1 \"Windows Registry Editor Version 5.00\" is missing");
    EXPECT_EQ(whyNot("REGEDIT\n[HKCU\\A]"), whyNot(""));
    const auto in3 = [](const std::string& text)
    {
        return whyNot(kBegin + text);
    };
    EXPECT_EQ(in3("[HKCU\\A"), "in line 3 the \"]\" after the key is missing");
    EXPECT_EQ(in3("["), "in line 3 the \"]\" after the key is missing");
    EXPECT_EQ(in3("[HKEY_LOCAL_MACHINE\\A]"), "in line 3 a key stands that is not below HKEY_CURRENT_USER");
    EXPECT_EQ(in3("[HKCUX]"), "in line 3 a key stands that is not below HKEY_CURRENT_USER");
    EXPECT_EQ(in3("[-HKCU]"), "in line 3 all of HKEY_CURRENT_USER would go");
    EXPECT_EQ(in3("\"x\"=\"y\""), "in line 3 a value stands without a key before it");
    EXPECT_EQ(in3("[-HKCU\\A]\n\"x\"=\"y\""), "in line 4 a value stands without a key before it");
    EXPECT_EQ(in3("[HKCU]\n\nx=\"y\""), "in line 5 neither a key nor a name in quotes begins");
    EXPECT_EQ(in3("[HKCU]\n\"x\" \"y\""), "in line 4 the \"=\" after a name is missing");
    EXPECT_EQ(in3("[HKCU]\n\"x\n\n"), "in line 4 a name begins that never ends");
    EXPECT_EQ(in3("[HKCU]\n\"x\"=\"y"), "in line 4 a text begins that never ends");
    EXPECT_EQ(in3("[HKCU]\n\"x\"=\"y\\\""), "in line 4 a text begins that never ends");
    EXPECT_EQ(in3("[HKCU]\n\"x\"=\"y\" z"), "in line 4 something stands after a value");
    EXPECT_EQ(in3("[HKCU]\n\"x\"=\"C:\\new\""),
              "in line 4 a \"\\\" stands alone, and is to be written twice");
    EXPECT_EQ(in3("[HKCU]\n\"x\"=\"\\"), "in line 4 a \"\\\" stands alone, and is to be written twice");
    EXPECT_EQ(in3("[HKCU]\n\"x\"=hex(1):61,00,62"), "in line 4 a text ends in the middle of a character");
    EXPECT_EQ(in3("[HKCU]\n\"x\"=hex(1):61,00,6"), "in line 4 something stands after a value");
}

TEST(RegistryText, RefusesWhatIsNoText)
{
    for (const std::string data : {"dword:00000001", "hex:01", "hex(2):61,00", "", "5"})
        EXPECT_EQ(whyNot(kBegin + "[HKCU\\A]\n\"x\"=" + data),
                  "in line 4 a value stands that is no text, and the registry holds texts alone");
    const std::string number0 = "in line 4 a character of the number 0 stands, which no text has";
    EXPECT_EQ(whyNot(kBegin + "[HKCU\\A]\n\"x\"=\"a" + std::string(1, '\0') + "b\""), number0);
    EXPECT_EQ(whyNot(kBegin + "[HKCU\\A]\n\"x\"=hex(1):61,00,00,00,62,00"), number0);
}

TEST(RegistryText, IsReadAsItWasWritten)
{
    for (const auto form : {RegistryTextForm::kUtf8, RegistryTextForm::kUtf16})
    {
        const auto changes = readRegistryText(written(kOfEachKind, form));
        ASSERT_TRUE(changes) << toUtf8(changes.sentence());
        EXPECT_EQ(withoutLines(*changes), kOfEachKind);
    }
}

TEST(RegistryText, IsWrittenInTheUsualForm)
{
    EXPECT_EQ(written({{Kind::kMakeKey, L"A\\B", L"", L""},
                       {Kind::kSetValue, L"A\\B", L"x\\", L"\""},
                       {Kind::kSetValue, L"A\\B", L"", L"two\nlines, longer"}}),
              kBegin +
                  "[HKEY_CURRENT_USER\\A\\B]\r\n\"x\\\\\"=\"\\\"\"\r\n"
                  "@=hex(1):74,00,77,00,6f,00,0a,00,6c,00,69,00,6e,00,65,00,73,00,2c,00,20,00,6c,00,\\\r\n"
                  "  6f,00,6e,00,67,00,65,00,72,00,00,00\r\n");
    EXPECT_THAT(written({}, RegistryTextForm::kUtf16), StartsWith(std::string("\xFF\xFEW\0i\0", 6)));
}

TEST(RegistryText, HasNoWayForALineBreakInTheNameOfAKey)
{
    const auto text = writeRegistryText({{Kind::kMakeKey, L"A\nB", L"", L""}}, RegistryTextForm::kUtf8);
    EXPECT_FALSE(text);
    EXPECT_THAT(toUtf8(text.sentence()), HasSubstr("line break"));
}
