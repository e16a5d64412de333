// Closing the dialog, and what it remembers.
#include "tests/e2e_dialogs/DialogTest.h"

using testing::HasSubstr;

class DialogClosing : public DialogTest
{
};

TEST_F(DialogClosing, ByEscapeLeavesAHostThatGoesOn)
{
    open();
    mScreen.key("Escape");
    EXPECT_TRUE(mScreen.waitUntilGone(kDialog));
    shoot("closed");
    mHost->type("VERSION");
    EXPECT_THAT(end(), HasSubstr("Command: VERSION\nTessel R21"));
}

TEST_F(DialogClosing, ByTheWindowsCloseButtonLeavesAHostThatGoesOn)
{
    open();
    mScreen.clickCloseButton(mDialog, places::kDialogWidth);
    EXPECT_TRUE(mScreen.waitUntilGone(kDialog));
    shoot("closed");
    mHost->type("VERSION");
    EXPECT_THAT(end(), HasSubstr("Command: VERSION\nTessel R21"));
}

TEST_F(DialogClosing, LeavesAModuleThatCanBeUnloadedAndLoadedAgain)
{
    const std::string first = writeLisp("a.lsp");
    setSetting("SaveHistory", "1");
    open();
    loadFile(0, "a.lsp");
    press("Escape");
    EXPECT_TRUE(mScreen.waitUntilGone(kDialog));
    mHost->type("UNLOAD Modrig.bundle");
    EXPECT_TRUE(prints("Modrig.bundle is unloaded."));
    mHost->type(std::string("LOAD ") + MODRIG_BUNDLE);
    EXPECT_TRUE(prints("Modrig.bundle is loaded."));
    openAgain();
    click(places::kHistoryTab);
    mScreen.doubleClick(mDialog, places::tableRow(0));
    EXPECT_TRUE(comesTrue(
        [&] { return mHost->output().rfind(wasLoaded("a.lsp")) > mHost->output().find("is unloaded."); }));
    shoot("loaded-again");
    closeAndEnd();
    EXPECT_EQ(stored("History"), "NumHistory = 1\n1History = " + first + "\n");
}

TEST_F(DialogClosing, RemembersTheTabAndTheCheckBox)
{
    const std::string first = writeLisp("a.lsp");
    const std::string second = writeLisp("b.lsp");
    storeHistory({first});
    open();
    click(places::kAddToHistory);
    click(places::kHistoryTab);
    shoot("changed");
    closeAndEnd();
    EXPECT_EQ(storedSetting("SaveHistory"), "1\n");
    EXPECT_EQ(storedSetting("LastTab"), "1\n");
    open();
    mScreen.doubleClick(mDialog, places::tableRow(0)); // only the tab of the History has this row
    EXPECT_TRUE(prints(wasLoaded("a.lsp")));
    loadFile(1, "b.lsp");
    shoot("loaded");
    closeAndEnd();
    EXPECT_EQ(stored("History"), "NumHistory = 2\n1History = " + first + "\n2History = " + second + "\n");
}

TEST_F(DialogClosing, RemembersThatTheTabAndTheCheckBoxWereChangedBack)
{
    setSetting("SaveHistory", "1");
    setSetting("LastTab", "1");
    open();
    click(places::kAddToHistory);
    click(places::kLoadedTab);
    shoot("changed-back");
    closeAndEnd();
    EXPECT_EQ(storedSetting("SaveHistory"), "0\n");
    EXPECT_EQ(storedSetting("LastTab"), "0\n");
}

TEST_F(DialogClosing, RemembersTheFolderOfTheFilesThatWereLoaded)
{
    mSession.folder().write("files/deeper/inner.lsp", "(write-line \"inner runs\")\n");
    open();
    mScreen.doubleClick(mDialog, places::file(0)); // the folder
    shoot("walked");
    loadFile(0, "inner.lsp");
    closeAndEnd();
    EXPECT_EQ(storedSetting("InitialPath"), (files() / "deeper").string() + "\n");
    open();
    shoot("again");
    loadFile(0, "inner.lsp");
    closeAndEnd();
}
