#include "host/text/Json.h"

#include <gtest/gtest.h>

namespace json = tessel::json;

TEST(Json, EscapesWhatEndsATextAndWhatATerminalObeys)
{
    EXPECT_EQ(json::text(L"plain größe 字 😀"), L"\"plain größe 字 😀\"");
    EXPECT_EQ(json::text(L"\"\\"), L"\"\\\"\\\\\"");
    EXPECT_EQ(json::text(L"\x01\n\x1f\x7f\x80\x9f\xa0"),
              L"\"\\u0001\\u000a\\u001f\\u007f\\u0080\\u009f\xa0\"");
}

TEST(Json, WritesAByteThatIsNoTextAsItsPrivateCharacter)
{
    EXPECT_EQ(json::text(std::wstring(1, wchar_t{0x10FE80})), L"\"\\udbff\\ude80\"");
    EXPECT_EQ(json::text(std::wstring(1, wchar_t{0x10FEFF})), L"\"\\udbff\\udeff\"");
    EXPECT_EQ(json::text(std::wstring(1, wchar_t{0x10FDFF})), L"\"\x10FDFF\"");
}

TEST(Json, PutsValuesTogetherInTheirOrder)
{
    EXPECT_EQ(json::list({}), L"[]");
    EXPECT_EQ(json::list({L"1", json::truth(true), json::truth(false)}), L"[1, true, false]");
    EXPECT_EQ(json::listOfTexts({L"a", L"b"}), L"[\"a\", \"b\"]");
    EXPECT_EQ(json::object({}), L"{}");
    EXPECT_EQ(json::object({{L"b", L"1"}, {L"a", json::text(L"")}}), L"{\"b\": 1, \"a\": \"\"}");
}
