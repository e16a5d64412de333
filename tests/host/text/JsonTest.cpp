#include "host/text/Json.h"

#include <gtest/gtest.h>

namespace json = tessel::json;
using tessel::Json;

namespace
{
std::wstring writtenText(std::wstring_view content)
{
    return json::written(json::text(content));
}
} // namespace

TEST(Json, EscapesWhatEndsATextAndWhatATerminalObeys)
{
    EXPECT_EQ(writtenText(L"plain größe 字 😀"), L"\"plain größe 字 😀\"");
    EXPECT_EQ(writtenText(L"\"\\"), L"\"\\\"\\\\\"");
    EXPECT_EQ(writtenText(L"\x01\n\x1f~\x7f\x80\x9f\xa0"),
              L"\"\\u0001\\n\\u001f~\\u007f\\u0080\\u009f\xa0\"");
}

TEST(Json, WritesAByteThatIsNoTextAsItsPrivateCharacter)
{
    EXPECT_EQ(writtenText(std::wstring(1, wchar_t{0x10FE80})), L"\"\\udbff\\ude80\"");
    EXPECT_EQ(writtenText(std::wstring(1, wchar_t{0x10FEFF})), L"\"\\udbff\\udeff\"");
    EXPECT_EQ(writtenText(std::wstring(1, wchar_t{0x10FDFF})), L"\"\x10FDFF\"");
}

TEST(Json, WritesTheMarkOfWhatIsMissingForWhatIsNoCharacter)
{
    EXPECT_EQ(writtenText(std::wstring(1, wchar_t{0xD800})), L"\"\xFFFD\"");
}

TEST(Json, PutsValuesTogetherInTheirOrder)
{
    EXPECT_EQ(json::written(json::listOfTexts({})), L"[]");
    EXPECT_EQ(json::written(json::listOfTexts({L"a", L"b"})), L"[\"a\",\"b\"]");
    EXPECT_EQ(json::written({{"b", 1}, {"a", json::text(L"")}, {"c", nullptr}, {"d", true}}),
              L"{\"b\":1,\"a\":\"\",\"c\":null,\"d\":true}");
}
