// The dialog's other buttons, and a message box that is closed by its frame.
#include "tests/e2e_dialogs/DialogTest.h"

class DialogEdges : public DialogTest
{
};

TEST_F(DialogEdges, LoadsSelectedHistoryRowsWithTheLoadButtonOfThePanel)
{
    openWithHistory({writeLisp("a.lsp"), writeLisp("b.lsp")});
    click(places::tableRow(1));
    click(places::kLoad);
    EXPECT_TRUE(prints(wasLoaded("b.lsp")));
    shoot("loaded");
    closeAndEnd();
}

TEST_F(DialogEdges, TakesHistoryRowsIntoTheStartupSuite)
{
    const std::string path = writeLisp("a.lsp");
    openWithHistory({path});
    click(places::tableRow(0));
    click(places::kAddToStartupSuite);
    EXPECT_TRUE(prints("a.lsp was added to the Startup Suite.\n"));
    shoot("added");
    closeAndEnd();
    EXPECT_EQ(stored("Startup"), "NumStartup = 1\n1Startup = " + path + "\n");
}

TEST_F(DialogEdges, AMessageBoxThatIsClosedByItsFrameIsAnswered)
{
    const std::string box = openMessageBox();
    ASSERT_FALSE(box.empty());
    mScreen.clickCloseButton(box, std::stoi(mScreen.sizeOf(box)));
    EXPECT_TRUE(mScreen.waitUntilGone(kMessageBox));
    ASSERT_TRUE(mScreen.waitUntilActive(mDialog));
    shoot("answered");
    closeAndEnd();
}

TEST_F(DialogEdges, TheCloseButtonClosesAndTheDialogOpensAgain)
{
    open();
    click(places::kClose);
    EXPECT_TRUE(mScreen.waitUntilGone(kDialog));
    shoot("closed");
    openAgain();
    shoot("again");
    closeAndEnd();
}
