// The Help buttons, with a stand-in for the person's browser.
#include <cstdlib>
#include <fstream>

#include "tests/e2e_dialogs/DialogTest.h"
#include "tests/support/ShellProgram.h"

class DialogHelp : public DialogTest
{
protected:
    DialogHelp()
    {
        const auto opener = writeProgram(mSession.folder(), "bin/xdg-open",
                                         "printf %s \"$1\" >" + note().string() + ".new && mv " +
                                             note().string() + ".new " + note().string());
        mSession.set("PATH", opener.parent_path().string() + ":" + std::getenv("PATH"));
    }

    // Waits until the browser has been given a page; answers the page's name.
    std::string openedPage() const
    {
        EXPECT_TRUE(comesTrue([this] { return std::filesystem::exists(note()); })) << "no page was opened";
        std::string page;
        std::getline(std::ifstream(note()), page);
        EXPECT_TRUE(std::filesystem::is_regular_file(page)) << page;
        return std::filesystem::path(page).filename().string();
    }

private:
    std::filesystem::path note() const { return mSession.folder() / "opened-page"; }
};

TEST_F(DialogHelp, OfTheMainDialogIsItsPage)
{
    open();
    click(places::kHelp);
    EXPECT_EQ(openedPage(), "load_unload_applications_dialog.html");
    EXPECT_TRUE(prints("The help opens in the browser: "));
    shoot("helped");
    closeAndEnd();
}

TEST_F(DialogHelp, OfTheStartupSuiteIsItsPage)
{
    open();
    openSuite();
    mScreen.click(mSuite, places::kSuiteHelp);
    EXPECT_EQ(openedPage(), "startup_suite_dialog.html");
    shoot("helped");
    mScreen.key("Escape");
    EXPECT_TRUE(mScreen.waitUntilGone(kSuiteDialog));
    closeAndEnd();
}

TEST_F(DialogHelp, OnChoosingFilesIsOpenedByTheCommand)
{
    EXPECT_EQ(mSession.run({"HELP StandardFileSelectionDialogs"}).exitStatus, 0);
    EXPECT_EQ(openedPage(), "StandardFileSelectionDialogs.html");
}
