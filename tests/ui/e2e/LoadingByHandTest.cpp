#include "tests/ui/e2e/DialogByHand.h"

using testing::HasSubstr;
using testing::Not;
using namespace places;

class LoadingByHand : public DialogByHand
{
};

TEST_F(LoadingByHand, ShowsTwoLoadedFilesInBothTables)
{
    lispFile("a.lsp");
    sample("primes.zmb");
    startHost();
    openDialog();
    picture("1-opened");
    click(kAddToHistory);
    click(fileInPanel(0));
    clickToo(fileInPanel(1));
    click(kLoad);
    EXPECT_TRUE(says("2 applications were loaded."));
    picture("2-two-files-loaded");
    click(kHistoryTab);
    picture("3-two-files-in-the-history");
    closeDialog();
    quit();
    EXPECT_THAT(stored(std::string(kModuleKey) + R"(\History)", "NumHistory"), HasSubstr("2"));
    EXPECT_THAT(stored(std::string(kModuleKey) + R"(\History)", "1History"), HasSubstr("a.lsp"));
    EXPECT_THAT(stored(std::string(kModuleKey) + R"(\History)", "2History"), HasSubstr("primes.zmb"));
}

TEST_F(LoadingByHand, SaysThatAFileIsLoadedAlready)
{
    sample("primes.zmb");
    startHost();
    openDialog();
    click(fileInPanel(0));
    click(kLoad);
    EXPECT_TRUE(says("primes.zmb was loaded."));
    click(kLoad);
    EXPECT_TRUE(says("primes.zmb is already loaded."));
    picture("4-already-loaded");
    closeDialog();
}

TEST_F(LoadingByHand, StopsAtTheSecondOfThreeFiles)
{
    lispFile("1.lsp");
    brokenModule("2.zmb");
    lispFile("3.lsp");
    startHost();
    openDialog();
    click(fileInPanel(0));
    clickToo(fileInPanel(1));
    clickToo(fileInPanel(2));
    click(kLoad);
    answerAlert("5-second-of-three-fails");
    picture("6-only-the-first-is-loaded");
    closeDialog();
    EXPECT_THAT(mTerminal->screen(), HasSubstr("1.lsp runs"));
    EXPECT_THAT(mTerminal->screen(), Not(HasSubstr("3.lsp runs")));
    EXPECT_THAT(mTerminal->screen(), Not(HasSubstr("loaded.\r\n2")));
    EXPECT_THAT(mTerminal->screen(), Not(HasSubstr("applications were loaded")));
}

TEST_F(LoadingByHand, LoadsAFileWithReturnAndByDoubleClick)
{
    lispFile("a.lsp");
    lispFile("b.lsp");
    startHost();
    openDialog();
    click(fileInPanel(1));
    mDesktop->key("Return");
    EXPECT_TRUE(says("b.lsp was loaded."));
    mDesktop->doubleClick(inDialog(fileInPanel(0)));
    EXPECT_TRUE(says("a.lsp was loaded."));
    picture("7-loaded-with-return-and-by-double-click");
    closeDialog();
}

TEST_F(LoadingByHand, LoadsHistoryEntriesWithTheLoadButtonsAndByDoubleClick)
{
    storeHistory({lispFile("a.lsp"), lispFile("b.lsp"), lispFile("c.lsp")});
    store(kSettingsKey, "LastTab", "1");
    startHost();
    openDialog();
    click(row(0));
    click(kLoad);
    EXPECT_TRUE(says("a.lsp was loaded."));
    click(row(1));
    click(kHistoryLoad);
    EXPECT_TRUE(says("b.lsp was loaded."));
    mDesktop->doubleClick(inDialog(row(2)));
    EXPECT_TRUE(says("c.lsp was loaded."));
    picture("8-loaded-from-the-history");
    closeDialog();
}

TEST_F(LoadingByHand, RemovesOneAndThenThreeHistoryEntries)
{
    storeHistory({lispFile("a.lsp"), lispFile("b.lsp"), lispFile("c.lsp"), lispFile("d.lsp")});
    store(kSettingsKey, "LastTab", "1");
    startHost();
    openDialog();
    click(row(1));
    click(kHistoryRemove);
    EXPECT_TRUE(says("b.lsp was removed from the History list."));
    picture("9-one-entry-removed");
    click(row(0));
    clickToo(row(1));
    clickToo(row(2));
    click(kHistoryRemove);
    EXPECT_TRUE(says("3 entries were removed from the History list."));
    picture("10-three-entries-removed");
    closeDialog();
    quit();
    EXPECT_THAT(stored(std::string(kModuleKey) + R"(\History)", "NumHistory"), HasSubstr("0"));
}

TEST_F(LoadingByHand, UnloadsAModule)
{
    const auto module = sample("primes.zmb");
    startHost();
    type("LOAD " + module.string());
    ASSERT_TRUE(says("Command: "));
    openDialog();
    click(row(0));
    click(kUnload);
    EXPECT_TRUE(says("primes.zmb was unloaded."));
    picture("11-unloaded");
    closeDialog();
    type("APPS");
    ASSERT_TRUE(says("Modrig.bundle"));
    ASSERT_TRUE(says("Command: "));
    const std::string& screen = mTerminal->screen();
    EXPECT_THAT(screen.substr(screen.rfind("Modrig.bundle")), Not(HasSubstr("primes.zmb")));
}

TEST_F(LoadingByHand, KeepsARowThatCannotBeUnloadedFromBeingSelected)
{
    const auto file = lispFile("a.lsp");
    startHost();
    type("LOAD " + file.string());
    ASSERT_TRUE(says("a.lsp runs"));
    openDialog();
    click(row(0));
    click(kUnload);
    picture("12-not-selectable");
    // The module behind it shows that the clicks before were through.
    sample("primes.zmb");
    closeDialog();
    EXPECT_THAT(mTerminal->screen(), Not(HasSubstr("unloaded")));
    type("APPS");
    EXPECT_TRUE(says("a.lsp"));
}

TEST_F(LoadingByHand, ShowsAndHidesFilesWithTheFilter)
{
    sample("calendar.qbc");
    lispFile("hill.lsp");
    sample("primes.zmb");
    startHost();
    openDialog();
    mDesktop->choose(inDialog(kFileTypes), inDialog(fileType(+3)));
    picture("13-lisp-source-only");
    click(fileInPanel(0));
    click(kLoad);
    EXPECT_TRUE(says("hill.lsp was loaded."));
    mDesktop->choose(inDialog(kFileTypes), inDialog(fileType(-3)));
    picture("14-all-applications-again");
    click(fileInPanel(2));
    click(kLoad);
    EXPECT_TRUE(says("primes.zmb was loaded."));
    closeDialog();
}

TEST_F(LoadingByHand, RemembersTabCheckBoxAndFolder)
{
    lispFile("deeper/a.lsp");
    startHost();
    openDialog();
    click(kAddToHistory);
    click(kHistoryTab);
    click(fileInPanel(0));
    click(fileInPanel(0));
    click(kLoad);
    EXPECT_TRUE(says("a.lsp was loaded."));
    closeDialog();
    quit();
    EXPECT_THAT(stored(kSettingsKey, "InitialPath"), HasSubstr("deeper"));
    startHost();
    openDialog();
    picture("15-tab-check-box-and-folder-remembered");
    click(fileInPanel(0));
    mDesktop->key("Return");
    EXPECT_TRUE(says("a.lsp was loaded."));
    closeDialog();
    quit();
    EXPECT_THAT(stored(kSettingsKey, "LastTab"), HasSubstr("1"));
    EXPECT_THAT(stored(kSettingsKey, "SaveHistory"), HasSubstr("1"));
}

TEST_F(LoadingByHand, ClosesWithEscapeWithItsButtonAndWithTheWindowsButton)
{
    startHost();
    openDialog();
    closeDialog();
    openDialog();
    click(kClose);
    EXPECT_TRUE(mDesktop->waitForWindowGone(kDialogTitle));
    EXPECT_TRUE(says("Command: "));
    openDialog();
    click(kCloseButtonOfFrame);
    EXPECT_TRUE(mDesktop->waitForWindowGone(kDialogTitle));
    EXPECT_TRUE(says("Command: "));
    picture("16-closed");
    quit();
}

TEST_F(LoadingByHand, TakesAClosedMessageBoxForAnswered)
{
    brokenModule("a.zmb");
    startHost();
    openDialog();
    click(fileInPanel(0));
    mDesktop->key("Return");
    ASSERT_TRUE(mDesktop->waitForWindow(kAlertTitle));
    mDesktop->key("alt+F4");
    EXPECT_TRUE(mDesktop->waitForWindowGone(kAlertTitle));
    closeDialog();
    quit();
}

TEST_F(LoadingByHand, OpensTheHelpPage)
{
    startHost();
    openDialog();
    click(kHelp);
    EXPECT_TRUE(says("load_unload_applications_dialog"));
    closeDialog();
}
