// Taps, as touch pads send them: press and release come at once. Each is the first that the program gets, for
// which the toolkit asks how the mouse is set up.
#include "tests/e2e_dialogs/DialogTest.h"

using testing::HasSubstr;

class DialogTaps : public DialogTest
{
protected:
    void tap(Place place) const { mScreen.tap(mDialog, place); }

    // A control that still waits for the release hears no key.
    void expectEscapeCloses(const std::string& title) const
    {
        mScreen.key("Escape");
        EXPECT_TRUE(mScreen.waitUntilGone(title));
    }
};

TEST_F(DialogTaps, SelectARow)
{
    openWithHistory({writeLisp("a.lsp"), writeLisp("b.lsp"), writeLisp("c.lsp")});
    tap(places::tableRow(1));
    mScreen.key("Delete");
    EXPECT_TRUE(prints("b.lsp was removed from the History list.\n"));
    expectEscapeCloses(kDialog);
}

TEST_F(DialogTaps, BringATabToTheFront)
{
    openWithHistory({writeLisp("a.lsp")});
    const std::string before = look(places::kHistoryTab);
    tap(places::kLoadedTab);
    EXPECT_TRUE(changes(places::kHistoryTab, before));
    expectEscapeCloses(kDialog);
}

TEST_F(DialogTaps, PressButtonsAndSegments)
{
    storeSuite({writeLisp("a.lsp"), writeLisp("b.lsp")});
    open();
    tap(places::kContents);
    mSuite = mScreen.waitForActive(kSuiteDialog);
    ASSERT_FALSE(mSuite.empty());
    mScreen.tap(mSuite, places::kFirstSuiteRow);
    mScreen.tap(mSuite, places::kRemove);
    expectEscapeCloses(kSuiteDialog);
    closeAndEnd();
    EXPECT_THAT(stored("Startup"), HasSubstr("NumStartup = 1\n"));
}

TEST_F(DialogTaps, OpenAndCloseThePopUpOfFileTypes)
{
    open();
    tap(places::kFileTypes);
    expectEscapeCloses(kDialog);
}

TEST_F(DialogTaps, ChooseAFileToLoad)
{
    writeLisp("a.lsp");
    open();
    tap(places::file(0));
    tap(places::kLoad);
    EXPECT_TRUE(prints(wasLoaded("a.lsp")));
    expectEscapeCloses(kDialog);
}
