// Closing the dialog, and what it remembers.
#include <sys/resource.h>

#include "tests/e2e_dialogs/DialogTest.h"

using testing::HasSubstr;
using testing::Not;

class DialogClosing : public DialogTest
{
protected:
    // As a disk does that has no more room: what the host prints is short enough.
    void limitFiles(rlim_t bytes) const
    {
        const rlimit limit = {bytes, RLIM_INFINITY};
        EXPECT_EQ(prlimit(mHost->process(), RLIMIT_FSIZE, &limit, nullptr), 0);
    }
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

TEST_F(DialogClosing, KeepsWhatFindsNoRoomAndStoresItOnceThereIsSome)
{
    const std::string path = writeLisp("a.lsp");
    storeHistory({"/before.lsp"});
    setSetting("SaveHistory", "1");
    open();
    loadFile(0, "a.lsp");
    limitFiles(4096);
    press("Escape");
    EXPECT_TRUE(mScreen.waitUntilGone(kDialog));
    EXPECT_TRUE(
        prints("registry.db could not be written: File too large. What was stored before is unchanged. "
               "Lift the limit on the size of files, and try again.\n"))
        << mHost->output();
    EXPECT_THAT(mHost->output(), HasSubstr("Message: A list of applications could not be stored"));
    EXPECT_EQ(stored("History"), "NumHistory = 1\n1History = /before.lsp\n");
    limitFiles(RLIM_INFINITY);
    openAgain();
    const std::string before = mHost->output();
    EXPECT_THAT(closeAndEnd().substr(before.size()), Not(HasSubstr("stored")));
    EXPECT_EQ(stored("History"), "NumHistory = 2\n1History = /before.lsp\n2History = " + path + "\n");
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
