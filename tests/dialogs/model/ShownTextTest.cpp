#include "modrig/dialogs/model/ShownText.h"

#include <gtest/gtest.h>

using ModrigUtils::ShownText;

TEST(ShownText, IsTheTextItselfInAnyScript)
{
    for (const wchar_t* text : {L"", L"tool.lsp", L"back\\slash.lsp", L"שלום.lsp", L"日本語 🎉"})
        EXPECT_EQ(text, ShownText(CStdStr(text)).Text());
}

TEST(ShownText, HoldsWhatIsNotVisibleAsAnEscape)
{
    EXPECT_EQ(L"new\\nline\\r\\t.lsp", ShownText(CStdStr(L"new\nline\r\t.lsp")).Text());
    EXPECT_EQ(L"a\\x01\\x1B\\x7F.lsp", ShownText(CStdStr(L"a\x01\x1B\x7F.lsp")).Text());
    EXPECT_EQ(L"\\x80\\xFF", ShownText(CStdStr(L"\U0010FE80\U0010FEFF")).Text()) << "bytes that are no text";
    EXPECT_EQ(L"\U0010FE7F\U0010FF00", ShownText(CStdStr(L"\U0010FE7F\U0010FF00")).Text());
}
