// The Startup Suite dialog over the main one.
#include <cstdio>

#include "tests/e2e_dialogs/DialogTest.h"

using testing::HasSubstr;
using testing::Not;

class DialogStartupSuite : public DialogTest
{
protected:
    void closeSuite()
    {
        mScreen.click(mSuite, places::kCloseSuite);
        EXPECT_TRUE(mScreen.waitUntilGone(kSuiteDialog));
    }

    void expectTheMainDialogAlone()
    {
        EXPECT_TRUE(mScreen.waitUntilGone(kSuiteDialog));
        EXPECT_TRUE(mScreen.waitUntilActive(mDialog));
        shoot("closed");
        click(places::kHistoryTab); // and it listens
        closeAndEnd();
        EXPECT_EQ(storedSetting("LastTab"), "1\n");
    }
};

TEST_F(DialogStartupSuite, TakesAFileThatTheNextStartLoads)
{
    const std::string file = writeLisp("suite.lsp");
    open();
    openSuite();
    mScreen.click(mSuite, places::kAdd);
    const std::string panel = mScreen.waitForActive(kAddPanel);
    ASSERT_FALSE(panel.empty());
    mScreen.text(files().string());
    mScreen.key("Return"); // goes to the folder
    mScreen.click(panel, places::file(0));
    shoot("selected");
    mScreen.key("Return");
    EXPECT_TRUE(mScreen.waitUntilGone(kAddPanel));
    EXPECT_TRUE(prints(wasLoaded("suite.lsp")));
    shoot("added");
    closeSuite();
    EXPECT_THAT(closeAndEnd(), HasSubstr("suite.lsp runs"));
    EXPECT_EQ(stored("Startup"), "NumStartup = 1\n1Startup = " + file + "\n");
    EXPECT_THAT(mSession.run({"VERSION"}).output, HasSubstr("suite.lsp runs"));
}

TEST_F(DialogStartupSuite, LosesAFileThatTheNextStartDoesNotLoad)
{
    const std::string first = writeLisp("first.lsp");
    const std::string second = writeLisp("second.lsp");
    storeSuite({first, second});
    open();
    openSuite();
    mScreen.click(mSuite, places::kFirstSuiteRow);
    shoot("selected");
    mScreen.click(mSuite, places::kRemove);
    shoot("removed");
    closeSuite();
    closeAndEnd();
    EXPECT_EQ(stored("Startup"), "NumStartup = 1\n1Startup = " + second + "\n");
    const std::string output = mSession.run({"VERSION"}).output;
    EXPECT_THAT(output, HasSubstr("second.lsp runs"));
    EXPECT_THAT(output, Not(HasSubstr("first.lsp")));
}

TEST_F(DialogStartupSuite, KeepsAFileOutAtStartsByTheMenuOfItsRow)
{
    const std::string first = writeLisp("first.lsp");
    const std::string second = writeLisp("second.lsp");
    storeSuite({first, second});
    open();
    openSuite();
    mScreen.chooseFromMenuAt(mSuite, places::kFirstSuiteRow, places::kKeepOutInSuiteMenu);
    shoot("chosen");
    closeSuite();
    closeAndEnd();
    EXPECT_EQ(stored("Startup"), "NumStartup = 2\n1Startup = " + first + "\n2Startup = " + second + "\n");
    const std::string output = mSession.run({"APPS"}).output;
    EXPECT_THAT(output, HasSubstr("second.lsp runs"));
    EXPECT_THAT(output, Not(HasSubstr("first.lsp runs")));
    EXPECT_THAT(output, HasSubstr("kept out at starts by DISABLE since "));
}

TEST_F(DialogStartupSuite, ClosesTheMenuOfARowByEscapeAndNothingElse)
{
    storeSuite({writeLisp("first.lsp")});
    open();
    openSuite();
    const auto hasMenu = [this]
    {
        return !mScreen.window("Window").empty();
    };
    for (const bool isHeld : {false, true})
    {
        mScreen.holdMenuOpenAt(mSuite, places::kFirstSuiteRow);
        if (!isHeld)
            mScreen.letGoOfMenu();
        ASSERT_TRUE(comesTrue(hasMenu)) << isHeld;
        shoot("open");
        press("x"); // is nobody's
        mScreen.key("Escape");
        EXPECT_TRUE(comesTrue([&] { return !hasMenu(); })) << isHeld;
        if (isHeld)
            mScreen.letGoOfMenu();
        EXPECT_FALSE(mScreen.window(kSuiteDialog).empty()) << isHeld;
        EXPECT_FALSE(mScreen.waitForActive(kSuiteDialog).empty()) << isHeld;
    }
    // The window goes on, and its own Escape is another one.
    mScreen.chooseFromMenuAt(mSuite, places::kFirstSuiteRow, places::kKeepOutInSuiteMenu);
    mScreen.key("Escape");
    EXPECT_TRUE(mScreen.waitUntilGone(kSuiteDialog));
    closeAndEnd();
    EXPECT_THAT(runQuietly({"APPS"}), HasSubstr("kept out at starts by DISABLE since "));
}

TEST_F(DialogStartupSuite, ShowsTipsInAsManyLinesAsTheyNeed)
{
    const std::string first = writeLisp(std::string(200, 'x') + ".lsp");
    storeSuite({first});
    runQuietly({"DISABLE " + first});
    open();
    openSuite();
    mScreen.moveOn(mSuite, places::kFirstSuiteRow);
    std::string tip;
    EXPECT_TRUE(comesTrue([&] { return !(tip = mScreen.window("Window")).empty(); }));
    shoot("tip");
    int width = 0;
    int height = 0;
    ASSERT_EQ(2, std::sscanf(mScreen.sizeOf(tip).c_str(), "%dx%d", &width, &height));
    EXPECT_LT(width, 700);
    EXPECT_GT(height, 60) << "four lines";
    closeSuite();
    closeAndEnd();
}

TEST_F(DialogStartupSuite, KeepsNothingOutThatIsNotThere)
{
    const std::string first = writeLisp("first.lsp");
    storeSuite({first});
    open();
    openSuite();
    std::filesystem::remove(first);
    mScreen.chooseFromMenuAt(mSuite, places::kFirstSuiteRow, places::kKeepOutInSuiteMenu);
    shoot("chosen");
    EXPECT_TRUE(prints("There is no application \"" + first + "\" that could be kept out.\n"));
    closeSuite();
    closeAndEnd();
    EXPECT_THAT(mSession.run({"APPS"}).output, Not(HasSubstr("kept out at starts")));
}

TEST_F(DialogStartupSuite, IsClosedByEscapeWithTheMainDialogLeftOpen)
{
    open();
    openSuite();
    mScreen.key("Escape");
    expectTheMainDialogAlone();
}

TEST_F(DialogStartupSuite, IsClosedByItsWindowsCloseButtonWithTheMainDialogLeftOpen)
{
    open();
    openSuite();
    mScreen.clickCloseButton(mSuite, places::kSuiteWidth);
    expectTheMainDialogAlone();
}
