// The dialogs without a mouse.
#include "tests/e2e_dialogs/DialogTest.h"

using testing::HasSubstr;

namespace
{
// How often Tab is pressed to get to a control from the list of files, where the keyboard is when the dialog
// opens. On the way are the name field and the switch for hidden files. What is disabled is left out.
constexpr int kTabsToLoad = 4;
constexpr int kTabsToAddToHistory = 5;
constexpr int kTabsToTabs = 6;
constexpr int kTabsToTable = 7;
constexpr int kTabsToContents = 8; // with nothing selected in the table
constexpr int kTabsToHelp = 9;
constexpr int kTabsToClose = 10;
constexpr int kTabsToWay = 13;

// From the table to what is under it when a row is selected.
constexpr int kTabsToFirstButton = 1; // Unload, or Load from the History
constexpr int kTabsToAddToStartupSuite = 2;
constexpr int kTabsToRemove = 3;

// In the Startup Suite's window.
constexpr int kTabsToSuiteHelp = 2;
constexpr int kTabsToSuiteClose = 3;
} // namespace

class DialogKeyboard : public DialogTest
{
protected:
    // Goes to a control and presses it.
    void pressAt(int tabs, const std::string& control) const
    {
        press("Tab", tabs);
        shoot("at-" + control);
        press("space");
    }

    void openWithTwoInHistory() { openWithHistory({writeLisp("a.lsp"), writeLisp("b.lsp")}); }

    void selectFirstRow() const
    {
        press("Tab", kTabsToTable);
        press("Down");
    }

    void openSuiteByKeys()
    {
        open();
        pressAt(kTabsToContents, "contents");
        const std::string suite = mScreen.waitForActive(kSuiteDialog);
        ASSERT_FALSE(suite.empty());
        shoot("suite");
    }

    void waitForTheMainDialog() const
    {
        ASSERT_TRUE(mScreen.waitUntilGone(kSuiteDialog));
        ASSERT_TRUE(mScreen.waitUntilActive(mDialog));
    }
};

TEST_F(DialogKeyboard, GoesToTheTabs)
{
    open();
    press("alt+2");
    shoot("history");
    closeAndEnd();
    EXPECT_EQ(storedSetting("LastTab"), "1\n");
    open();
    press("alt+1");
    shoot("loaded-applications");
    closeAndEnd();
    EXPECT_EQ(storedSetting("LastTab"), "0\n");
}

// A stop of the Tab key, and a place at the edge of the control, where it shows that it has the keyboard.
struct Stop
{
    const char* name;
    Place edge;
};

TEST_F(DialogKeyboard, ComesToEveryControlInTheOrderOfReading)
{
    const Stop kStops[] = {{"name", {545, 346}},
                           {"hidden-files", {715, 330}},
                           {"file-types", {100, 375}},
                           {"load", {715, 376}},
                           {"add-to-history", {620, 405}},
                           {"tabs", {60, 410}},
                           {"table", {30, 550}},
                           {"contents", {575, 620}},
                           {"help", {35, 708}},
                           {"close", {655, 708}},
                           {"up", {35, 21}},
                           {"home", {160, 21}}};
    open();
    std::string lastBefore;
    const Stop* last = nullptr;
    for (const Stop& stop : kStops)
    {
        const std::string before = look(stop.edge);
        press("Tab");
        EXPECT_TRUE(changes(stop.edge, before)) << stop.name;
        shoot(std::string("at-") + stop.name);
        EXPECT_TRUE(!last || comesTrue([&] { return look(last->edge) == lastBefore; })) << stop.name;
        last = &stop;
        lastBefore = before;
    }
    closeAndEnd();
}

TEST_F(DialogKeyboard, GoesToFoldersOnTheWayWithTheArrows)
{
    writeLisp("inner/a.lsp");
    writeLisp("b.lsp");
    setSetting("InitialPath", (files() / "inner").string());
    open();
    press("Tab", kTabsToWay);
    shoot("at-way");
    press("Left");
    shoot("at-folder-above");
    press("space");
    press("Right"); // there is none further in any more
    press("alt+n");
    mScreen.text("b.lsp");
    shoot("went-up");
    press("Return");
    EXPECT_TRUE(prints(wasLoaded("b.lsp")));
    closeAndEnd();
}

TEST_F(DialogKeyboard, GoesFromTabToTabWithTheArrows)
{
    open();
    press("Tab", kTabsToTabs);
    press("Right", 2); // there is no third
    shoot("history");
    closeAndEnd();
    EXPECT_EQ(storedSetting("LastTab"), "1\n");
    open();
    press("Tab", kTabsToTabs);
    press("Left", 2);
    shoot("loaded-applications");
    closeAndEnd();
    EXPECT_EQ(storedSetting("LastTab"), "0\n");
}

TEST_F(DialogKeyboard, PressesControlsByTheirLetters)
{
    writeLisp("a.lsp");
    writeBroken();
    open();
    press("alt+a"); // Add to History
    press("alt+n"); // Name
    mScreen.text((files() / "a.lsp").string());
    press("alt+l"); // Load
    EXPECT_TRUE(prints(wasLoaded("a.lsp")));
    press("alt+s"); // History
    shoot("history");
    press("alt+t"); // Contents
    const std::string suite = mScreen.waitForActive(kSuiteDialog);
    ASSERT_FALSE(suite.empty());
    shoot("suite");
    press("alt+c"); // Close
    waitForTheMainDialog();
    press("alt+n");
    press("ctrl+a");
    mScreen.text((files() / "broken.zmb").string());
    press("alt+l");
    ASSERT_FALSE(mScreen.waitForActive(kMessageBox).empty());
    shoot("box");
    press("alt+o"); // OK
    EXPECT_TRUE(mScreen.waitUntilGone(kMessageBox));
    ASSERT_TRUE(mScreen.waitUntilActive(mDialog));
    press("alt+c");
    EXPECT_TRUE(mScreen.waitUntilGone(kDialog));
    end();
    EXPECT_EQ(storedSetting("LastTab"), "1\n");
    EXPECT_EQ(storedSetting("SaveHistory"), "1\n");
}

TEST_F(DialogKeyboard, ReachesTheCheckBoxWithTab)
{
    open();
    press("Tab", kTabsToAddToHistory);
    shoot("check-box-has-the-keyboard");
    const std::string before = look(places::kAddToHistory);
    press("space");
    EXPECT_TRUE(changes(places::kAddToHistory, before));
    shoot("switched-on");
    closeAndEnd();
    EXPECT_EQ(storedSetting("SaveHistory"), "1\n");
}

TEST_F(DialogKeyboard, LoadsAFileThatTheArrowKeysChose)
{
    writeLisp("a.lsp");
    writeLisp("b.lsp");
    open();
    press("Down", 2);
    pressAt(kTabsToLoad, "load");
    EXPECT_TRUE(prints(wasLoaded("b.lsp")));
    shoot("loaded");
    closeAndEnd();
}

TEST_F(DialogKeyboard, Unloads)
{
    storeSuite({copySample("gears.omp")});
    open();
    selectFirstRow();
    pressAt(kTabsToFirstButton, "unload");
    EXPECT_TRUE(prints("gears.omp was unloaded.\n"));
    shoot("unloaded");
    closeAndEnd();
}

TEST_F(DialogKeyboard, LoadsFromTheHistory)
{
    openWithTwoInHistory();
    selectFirstRow();
    pressAt(kTabsToFirstButton, "load");
    EXPECT_TRUE(prints(wasLoaded("a.lsp")));
    shoot("loaded");
    closeAndEnd();
}

TEST_F(DialogKeyboard, AddsToTheStartupSuiteFromTheHistory)
{
    openWithTwoInHistory();
    selectFirstRow();
    pressAt(kTabsToAddToStartupSuite, "add-to-startup-suite");
    EXPECT_TRUE(prints("a.lsp was added to the Startup Suite.\n"));
    shoot("added");
    closeAndEnd();
}

TEST_F(DialogKeyboard, RemovesFromTheHistory)
{
    openWithTwoInHistory();
    selectFirstRow();
    pressAt(kTabsToRemove, "remove");
    EXPECT_TRUE(prints("a.lsp was removed from the History list.\n"));
    shoot("removed");
    closeAndEnd();
}

TEST_F(DialogKeyboard, OpensTheHelp)
{
    mSession.set("PATH", ""); // no browser: the page is printed
    open();
    pressAt(kTabsToHelp, "help");
    EXPECT_TRUE(prints("load_unload_applications_dialog.html"));
    shoot("helped");
    closeAndEnd();
}

TEST_F(DialogKeyboard, Closes)
{
    open();
    pressAt(kTabsToClose, "close");
    EXPECT_TRUE(mScreen.waitUntilGone(kDialog));
    shoot("closed");
    mHost->type("VERSION");
    EXPECT_THAT(end(), HasSubstr("Command: VERSION\nTessel R21"));
}

TEST_F(DialogKeyboard, OpensTheStartupSuiteAndItsHelpAndClosesIt)
{
    mSession.set("PATH", "");
    openSuiteByKeys();
    pressAt(kTabsToSuiteHelp, "suite-help");
    EXPECT_TRUE(prints("startup_suite_dialog.html"));
    pressAt(kTabsToSuiteClose - kTabsToSuiteHelp, "suite-close");
    waitForTheMainDialog();
    shoot("closed");
    closeAndEnd();
}

TEST_F(DialogKeyboard, AddsToTheStartupSuiteWithInsert)
{
    const std::string file = writeLisp("a.lsp");
    openSuiteByKeys();
    press("Insert");
    const std::string panel = mScreen.waitForActive(kAddPanel);
    ASSERT_FALSE(panel.empty());
    mScreen.text(file);
    shoot("typed");
    press("Return");
    EXPECT_TRUE(mScreen.waitUntilGone(kAddPanel));
    EXPECT_TRUE(prints(wasLoaded("a.lsp")));
    shoot("added");
    press("Escape");
    waitForTheMainDialog();
    closeAndEnd();
    EXPECT_EQ(stored("Startup"), "NumStartup = 1\n1Startup = " + file + "\n");
}

TEST_F(DialogKeyboard, RemovesFromTheStartupSuiteWithDelete)
{
    storeSuite({writeLisp("a.lsp"), writeLisp("b.lsp")});
    openSuiteByKeys();
    press("Down");
    shoot("selected");
    press("Delete");
    shoot("removed");
    press("Escape");
    waitForTheMainDialog();
    closeAndEnd();
    EXPECT_EQ(stored("Startup"), "NumStartup = 1\n1Startup = " + (files() / "b.lsp").string() + "\n");
}
