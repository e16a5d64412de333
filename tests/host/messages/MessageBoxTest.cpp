#include <gtest/gtest.h>

#include <vector>

#include "host/messages/MessageBox.h"
#include "tests/host/support/HostParts.h"

namespace
{
// A presenter that keeps the detail of each box, whose first button is pressed.
tessel::MessageBox::Presenter noting(std::vector<std::wstring>& details)
{
    return [&details](const tessel::MessageBox::Box& shown)
    {
        details.push_back(shown.detail);
        return IDOK;
    };
}
} // namespace

TEST(MessageBox, IsTextWithTheFirstButtonChosenWithoutADisplay)
{
    CapturedOutput output;
    const tessel::Owned<tessel::MessageBox> box(output.commandLine());
    output.commandLine().print(L"Loading");
    EXPECT_EQ(VqHostMessageBox::simple()->show(L"100%s/größe.lsp is missing.", MB_ICONEXCLAMATION, nullptr),
              IDOK);
    EXPECT_EQ(output.text(), "Loading\nMessage: 100%s/größe.lsp is missing.\n");
}

TEST(MessageBox, IsShownByThePresenterWhenThereIsOne)
{
    CapturedOutput output;
    std::wstring seen;
    unsigned seenStyle = 0;
    tessel::MessageBox box(output.commandLine(),
                           [&](const tessel::MessageBox::Box& shown)
                           {
                               seen = shown.text;
                               seenStyle = shown.style;
                               return 7;
                           });
    EXPECT_EQ(box.show(L"text", MB_ICONEXCLAMATION, nullptr), 7);
    EXPECT_EQ(seen, L"text");
    EXPECT_EQ(seenStyle, MB_ICONEXCLAMATION);
    EXPECT_EQ(output.text(), "");
    tessel::MessageBox without(output.commandLine(), {});
    EXPECT_EQ(without.show(L"text", MB_ICONEXCLAMATION, nullptr), IDOK);
    EXPECT_EQ(output.text(), "Message: text\n");
}

TEST(MessageBox, IsTextWhereThePresenterCannotShowIt)
{
    CapturedOutput output;
    tessel::MessageBox box(output.commandLine(), [](const tessel::MessageBox::Box&) { return 0; });
    EXPECT_EQ(box.show(L"text", MB_OK, nullptr), IDOK);
    EXPECT_EQ(output.text(), "Message: text\n");
}

TEST(MessageBox, SaysInItsDetailWhatIsKnownOfTheFileThatItNames)
{
    CapturedOutput output;
    std::vector<std::wstring> details;
    tessel::MessageBox box(output.commandLine(), noting(details));
    box.explain(L"/a/tool.zmb", L"it has no entry point.");
    box.show(L"/a/tool.zmb was not loaded.", MB_ICONEXCLAMATION, nullptr);
    box.show(L"/a/tool.zmb was not loaded.", MB_ICONEXCLAMATION, nullptr);
    box.explain(L"/a/tool.zmb", L"it has no entry point.");
    box.show(L"/a/other.zmb was not loaded.", MB_ICONEXCLAMATION, nullptr);
    EXPECT_EQ(details, (std::vector<std::wstring>{L"It has no entry point.", L"", L""}));
}

TEST(MessageBox, BeginsItsDetailWithACapitalUnlessThatIsAName)
{
    CapturedOutput output;
    std::vector<std::wstring> details;
    tessel::MessageBox box(output.commandLine(), noting(details));
    for (const wchar_t* why : {L"cut", L"it is", L"libc.so: gone", L"/a/b: gone", L"xy7 is", L"It is", L""})
    {
        box.explain(L"/a/tool.zmb", why);
        box.show(L"/a/tool.zmb was not loaded.", MB_ICONEXCLAMATION, nullptr);
    }
    EXPECT_EQ(details, (std::vector<std::wstring>{L"Cut", L"It is", L"libc.so: gone", L"/a/b: gone",
                                                  L"xy7 is", L"It is", L""}));
}

TEST(MessageBox, LeavesTheDetailToTheCommandLineWithoutADisplay)
{
    CapturedOutput output;
    tessel::MessageBox box(output.commandLine());
    box.explain(L"/a/tool.zmb", L"it has no entry point.");
    box.show(L"/a/tool.zmb was not loaded.", MB_ICONEXCLAMATION, nullptr);
    EXPECT_EQ(output.text(), "Message: /a/tool.zmb was not loaded.\n");
}

TEST(MessageBox, IsKeptWhileBoxesAreCollected)
{
    CapturedOutput output;
    int shown = 0;
    tessel::MessageBox box(output.commandLine(), [&](const tessel::MessageBox::Box&) { return ++shown; });
    box.collect();
    box.explain(L"/a/tool.zmb", L"it is gone.");
    EXPECT_EQ(box.show(L"/a/tool.zmb was not loaded.", MB_ICONEXCLAMATION, nullptr), IDOK);
    EXPECT_EQ(box.show(L"another", MB_OK, nullptr), IDOK);
    EXPECT_EQ(shown, 0);
    const auto kept = box.takeCollected();
    ASSERT_EQ(kept.size(), 2U);
    EXPECT_EQ(kept[0].text, L"/a/tool.zmb was not loaded.");
    EXPECT_EQ(kept[0].detail, L"It is gone.");
    EXPECT_EQ(kept[0].style, MB_ICONEXCLAMATION);
    EXPECT_EQ(kept[1].text, L"another");
    EXPECT_TRUE(box.takeCollected().empty());
    EXPECT_EQ(box.show(L"later", MB_OK, nullptr), 1);
    EXPECT_EQ(shown, 1);
    EXPECT_EQ(output.text(), "");
}

TEST(MessageBox, IsShownOverTheWindowThatItBelongsToAlsoWhileBoxesAreCollected)
{
    CapturedOutput output;
    tessel::MessageBox box(output.commandLine());
    box.collect();
    int window = 0;
    box.show(L"text", MB_OK, &window);
    EXPECT_EQ(output.text(), "Message: text\n");
    EXPECT_TRUE(box.takeCollected().empty());
}

TEST(MessageBox, OfTheHostIsWrittenOutInLinesWhereItCannotBeShown)
{
    CapturedOutput output;
    tessel::MessageBox box(output.commandLine());
    box.show({.text = L"2 things.", .detail = L"One, two."}, L"2 things:\n  one\n  two", false);
    EXPECT_EQ(output.text(), "Message: 2 things:\n  one\n  two\n");
    std::wstring seen;
    tessel::MessageBox window(output.commandLine(),
                              [&](const tessel::MessageBox::Box& shown)
                              {
                                  seen = shown.text + shown.detail;
                                  return IDOK;
                              });
    window.show({.text = L"2 things.", .detail = L"One, two."}, L"lines", false);
    EXPECT_EQ(seen, L"2 things.One, two.");
    EXPECT_EQ(output.text(), "Message: 2 things:\n  one\n  two\n");
    window.show({.text = L"3 things.", .detail = L"One."}, L"all three", true);
    EXPECT_EQ(seen, L"3 things.One.");
    EXPECT_EQ(output.text(), "Message: 2 things:\n  one\n  two\nMessage: all three\n");
}

TEST(MessageBox, IsThereEvenWithoutAHost)
{
    ASSERT_NE(VqHostMessageBox::simple(), nullptr);
    EXPECT_EQ(VqHostMessageBox::simple()->show(nullptr, MB_OK, nullptr), IDOK);
}
