// Windows that wait for an answer, over those that they came from.
#include "tests/e2e_dialogs/DialogTest.h"

#include <cstdio>
#include <ios>
#include <sstream>

using testing::HasSubstr;
using testing::Not;

namespace
{
constexpr Place kEmptyPlaceOfDialog{400, 708}; // that no window over the dialog reaches
constexpr Place kEmptyPlaceOfSuite{200, 345};
constexpr int kFrame = 20; // by which the middles of two windows may differ

class ModalWindows : public DialogTest
{
protected:
    void expectBelongsTo(const std::string& owner, const std::string& window) const
    {
        std::ostringstream id;
        id << "window id # 0x" << std::hex << std::stoul(owner);
        EXPECT_EQ(mScreen.property(window, "WM_TRANSIENT_FOR"), id.str());
        EXPECT_EQ(mScreen.property(window, "_NET_WM_WINDOW_TYPE"), "_NET_WM_WINDOW_TYPE_DIALOG");
        EXPECT_EQ(mScreen.property(window, "_NET_WM_STATE"), "_NET_WM_STATE_MODAL");
        EXPECT_NEAR(mScreen.middleOf(window).x, mScreen.middleOf(owner).x, kFrame);
        EXPECT_NEAR(mScreen.middleOf(window).y, mScreen.middleOf(owner).y, kFrame);
    }

    void expectStaysOver(const std::string& owner, Place place, const std::string& window) const
    {
        mScreen.click(owner, place);
        shoot("clicked-behind");
        EXPECT_TRUE(mScreen.isOver(window, owner));
        EXPECT_TRUE(mScreen.waitUntilActive(window));
    }

    // The numbers that window managers have taken from Motif. Not all of them keep to it.
    void expectWantsNoMinimizeButton(const std::string& window) const
    {
        constexpr unsigned kHasFunctionsAndDecorations = 3;
        constexpr unsigned kAllOrMinimizeFunction = 1 | 8;
        constexpr unsigned kAllOrMinimizeButton = 1 | 32;
        unsigned flags = 0;
        unsigned functions = 0;
        unsigned decorations = 0;
        const std::string hints = mScreen.property(window, "_MOTIF_WM_HINTS");
        ASSERT_EQ(3, std::sscanf(hints.c_str(), "0x%x, 0x%x, 0x%x", &flags, &functions, &decorations))
            << hints;
        EXPECT_EQ(flags & kHasFunctionsAndDecorations, kHasFunctionsAndDecorations) << hints;
        EXPECT_EQ(functions & kAllOrMinimizeFunction, 0u) << hints;
        EXPECT_EQ(decorations & kAllOrMinimizeButton, 0u) << hints;
    }

    void expectComesBackWhenMinimized(const std::string& window, const char* title) const
    {
        mScreen.minimize(window);
        EXPECT_TRUE(comesTrue([&] { return mScreen.window(title) == window; }));
    }
};
} // namespace

TEST_F(ModalWindows, AMessageBoxBelongsToTheDialogAndStaysOverIt)
{
    const std::string box = openMessageBox();
    expectBelongsTo(mDialog, box);
    expectWantsNoMinimizeButton(box);
    expectStaysOver(mDialog, kEmptyPlaceOfDialog, box);
    dismissMessageBox();
    closeAndEnd();
}

TEST_F(ModalWindows, AMessageBoxIsAnsweredByEscapeAndByItsButton)
{
    openMessageBox();
    mScreen.key("Escape");
    EXPECT_TRUE(mScreen.waitUntilGone(kMessageBox));
    ASSERT_TRUE(mScreen.waitUntilActive(mDialog));
    click(places::kLoad);
    const std::string box = mScreen.waitForActive(kMessageBox);
    ASSERT_FALSE(box.empty());
    const std::string size = mScreen.sizeOf(box);
    const int width = std::stoi(size);
    const int height = std::stoi(size.substr(size.find('x') + 1));
    mScreen.click(box, {width - 60, height - 36});
    EXPECT_TRUE(mScreen.waitUntilGone(kMessageBox));
    closeAndEnd();
}

TEST_F(ModalWindows, TheButtonThatOpenedAMessageBoxIsDrawnReleased)
{
    writeBroken();
    open();
    click(places::file(0));
    const Place besideItsText{places::kLoad.x + 20, places::kLoad.y};
    const std::string before = look(besideItsText);
    click(places::kLoad);
    const std::string box = mScreen.waitForActive(kMessageBox);
    ASSERT_FALSE(box.empty());
    shoot("released");
    EXPECT_EQ(look(besideItsText), before);
    dismissMessageBox();
    closeAndEnd();
}

TEST_F(ModalWindows, TheStartupSuiteBelongsToTheDialogAndStaysOverIt)
{
    open();
    openSuite();
    expectBelongsTo(mDialog, mSuite);
    expectWantsNoMinimizeButton(mSuite);
    expectStaysOver(mDialog, kEmptyPlaceOfDialog, mSuite);
    mScreen.key("Escape");
    EXPECT_TRUE(mScreen.waitUntilGone(kSuiteDialog));
    closeAndEnd();
}

TEST_F(ModalWindows, TheAddPanelBelongsToTheStartupSuiteAndStaysOverBoth)
{
    open();
    openSuite();
    mScreen.click(mSuite, places::kAdd);
    const std::string panel = mScreen.waitForActive(kAddPanel);
    ASSERT_FALSE(panel.empty());
    expectBelongsTo(mSuite, panel);
    expectWantsNoMinimizeButton(panel);
    expectStaysOver(mSuite, kEmptyPlaceOfSuite, panel);
    expectStaysOver(mDialog, kEmptyPlaceOfDialog, panel);
    mScreen.key("Escape");
    EXPECT_TRUE(mScreen.waitUntilGone(kAddPanel));
    ASSERT_TRUE(mScreen.waitUntilActive(mSuite));
    mScreen.key("Escape");
    EXPECT_TRUE(mScreen.waitUntilGone(kSuiteDialog));
    closeAndEnd();
}

TEST_F(ModalWindows, TheDialogIsInTheTaskBarAndTellsItsProcess)
{
    open();
    EXPECT_THAT(mScreen.property(mDialog, "_NET_WM_STATE"), Not(HasSubstr("SKIP")));
    EXPECT_EQ(mScreen.property(mDialog, "_NET_WM_WINDOW_TYPE"), "_NET_WM_WINDOW_TYPE_NORMAL");
    EXPECT_EQ(mScreen.property(mDialog, "_NET_WM_PID"), std::to_string(mHost->process()));
    EXPECT_THAT(mScreen.property(mDialog, "WM_CLIENT_MACHINE"), Not(testing::IsEmpty()));
    closeAndEnd();
}

TEST_F(ModalWindows, TheDialogComesBackWhenItIsMinimized)
{
    open();
    expectComesBackWhenMinimized(mDialog, kDialog);
    shoot("back");
    closeAndEnd();
}

TEST_F(ModalWindows, AMessageBoxComesBackWhenItIsMinimized)
{
    expectComesBackWhenMinimized(openMessageBox(), kMessageBox);
    shoot("back");
    dismissMessageBox();
    closeAndEnd();
}
