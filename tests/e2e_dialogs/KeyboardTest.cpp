// The dialogs without a mouse.
#include "tests/e2e_dialogs/DialogTest.h"

class DialogKeyboard : public DialogTest
{
protected:
    void press(const std::string& key, int times = 1) const
    {
        for (int time = 0; time < times; ++time)
            mScreen.key(key);
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
    closeAndEnd();
    EXPECT_EQ(storedSetting("LastTab"), "0\n");
}

// From the name field: Help, Close, the browser and its columns, the file types, the check box.
TEST_F(DialogKeyboard, ReachesTheCheckBoxWithTab)
{
    open();
    press("Tab", 6);
    shoot("check-box-has-the-keyboard");
    press("space");
    closeAndEnd();
    EXPECT_EQ(storedSetting("SaveHistory"), "1\n");
}

TEST_F(DialogKeyboard, OpensTheStartupSuiteAndRemovesFromItWithDelete)
{
    storeSuite({writeLisp("a.lsp"), writeLisp("b.lsp")});
    open();
    click(places::kContents);
    const std::string suite = mScreen.waitForWindow(kSuiteDialog);
    ASSERT_FALSE(suite.empty());
    ASSERT_TRUE(mScreen.waitUntilActive(suite));
    press("Down");
    press("Delete");
    shoot("removed");
    press("Escape");
    ASSERT_TRUE(mScreen.waitUntilGone(kSuiteDialog));
    ASSERT_TRUE(mScreen.waitUntilActive(mDialog));
    closeAndEnd();
    EXPECT_EQ(stored("Startup"), "NumStartup = 1\n1Startup = " + (files() / "b.lsp").string() + "\n");
}
