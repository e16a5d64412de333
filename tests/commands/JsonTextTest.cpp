#include "modrig/commands/JsonText.h"

#include <gtest/gtest.h>

using ModrigUtils::InJson;

TEST(JsonText, EscapesWhatEndsATextAndWhatATerminalObeys)
{
    EXPECT_EQ(InJson(L"plain größe 字 😀"), L"\"plain größe 字 😀\"");
    EXPECT_EQ(InJson(L"\"\\"), L"\"\\\"\\\\\"");
    EXPECT_EQ(InJson(L"\x01\n\x1f\x7f\x80\x9f\xa0"), L"\"\\u0001\\u000a\\u001f\\u007f\\u0080\\u009f\xa0\"");
}

TEST(JsonText, WritesAByteThatIsNoTextAsItsPrivateCharacter)
{
    EXPECT_EQ(InJson(std::wstring(1, wchar_t{0x10FE80})), L"\"\\udbff\\ude80\"");
    EXPECT_EQ(InJson(std::wstring(1, wchar_t{0x10FEFF})), L"\"\\udbff\\udeff\"");
    EXPECT_EQ(InJson(std::wstring(1, wchar_t{0x10FDFF})), L"\"\x10FDFF\"");
}
