#include "tests/ui/e2e/DialogByHand.h"

using testing::HasSubstr;
using namespace places;

class StartupSuiteByHand : public DialogByHand
{
protected:
    std::string suiteKey() const { return std::string(kModuleKey) + R"(\Startup)"; }
    std::vector<std::filesystem::path> lispFiles(int count)
    {
        std::vector<std::filesystem::path> files;
        for (int index = 0; index < count; ++index)
            files.push_back(lispFile("tool" + std::to_string(index + 10) + ".lsp"));
        return files;
    }
};

TEST_F(StartupSuiteByHand, IsAddedToRemovedFromStoredAndLoadedAtTheNextStart)
{
    lispFile("a.lsp");
    lispFile("b.lsp");
    storeHistory({folder() / "a.lsp", folder() / "b.lsp"});
    store(kSettingsKey, "LastTab", "1");
    startHost();
    openDialog();
    click(row(0));
    clickToo(row(1));
    click(kHistoryAdd);
    EXPECT_TRUE(says("2 applications were added to the Startup Suite."));
    click(kContents);
    ASSERT_TRUE(mDesktop->waitForWindow(kSuiteTitle));
    const Point suite = mDesktop->originOf(kSuiteTitle);
    picture("20-startup-suite");
    mDesktop->click(suite + suiteRow(0));
    mDesktop->click(suite + kSuiteRemove);
    picture("21-removed-from-the-startup-suite");
    mDesktop->key("Escape");
    ASSERT_TRUE(mDesktop->waitForWindowGone(kSuiteTitle));
    closeDialog();
    quit();
    EXPECT_THAT(stored(suiteKey(), "NumStartup"), HasSubstr("1"));
    EXPECT_THAT(stored(suiteKey(), "1Startup"), HasSubstr("b.lsp"));
    startHost();
    EXPECT_THAT(mTerminal->screen(), HasSubstr("b.lsp runs"));
}

TEST_F(StartupSuiteByHand, TakesAFileFromTheFileDialog)
{
    startHost();
    openDialog();
    click(kContents);
    ASSERT_TRUE(mDesktop->waitForWindow(kSuiteTitle));
    mDesktop->click(mDesktop->originOf(kSuiteTitle) + kSuiteAdd);
    ASSERT_TRUE(mDesktop->waitForWindow("Add to Startup Suite"));
    picture("22-adding-to-the-startup-suite");
    mDesktop->key("Escape");
    EXPECT_TRUE(mDesktop->waitForWindowGone("Add to Startup Suite"));
    mDesktop->key("Escape");
    EXPECT_TRUE(mDesktop->waitForWindowGone(kSuiteTitle));
    closeDialog();
}

TEST_F(StartupSuiteByHand, LoadsTwoFilesDroppedOnTheTable)
{
    const auto files = lispFiles(2);
    startHost();
    openDialog();
    mDesktop->dropFiles(files, inDialog(belowRows()));
    EXPECT_TRUE(says("2 applications were loaded."));
    picture("23-two-files-dropped-on-the-table");
    closeDialog();
}

TEST_F(StartupSuiteByHand, LoadsFiftyFilesDroppedOnTheTable)
{
    const auto files = lispFiles(50);
    startHost();
    openDialog();
    mDesktop->dropFiles(files, inDialog(belowRows()));
    EXPECT_TRUE(says("50 applications were loaded."));
    picture("24-fifty-files-dropped-on-the-table");
    closeDialog();
}

TEST_F(StartupSuiteByHand, RefusesFiftyOneFilesDroppedOnTheTable)
{
    const auto files = lispFiles(51);
    startHost();
    openDialog();
    mDesktop->dropFiles(files, inDialog(belowRows()));
    answerAlert("25-fifty-one-files-dropped-on-the-table");
    closeDialog();
    EXPECT_THAT(mTerminal->screen(), testing::Not(HasSubstr("runs")));
}

TEST_F(StartupSuiteByHand, TakesTwoAndFiftyFilesDroppedOnItsBox)
{
    auto files = lispFiles(52);
    const std::vector<std::filesystem::path> two(files.begin(), files.begin() + 2);
    files.erase(files.begin(), files.begin() + 2);
    startHost();
    openDialog();
    mDesktop->dropFiles(two, inDialog(kStartupSuiteBox));
    EXPECT_TRUE(says("2 applications were added to the Startup Suite."));
    mDesktop->dropFiles(files, inDialog(kStartupSuiteBox));
    EXPECT_TRUE(says("50 applications were added to the Startup Suite."));
    picture("26-fifty-two-files-in-the-startup-suite");
    closeDialog();
    quit();
    EXPECT_THAT(stored(suiteKey(), "NumStartup"), HasSubstr("52"));
}

TEST_F(StartupSuiteByHand, RefusesFiftyOneFilesDroppedOnItsBox)
{
    const auto files = lispFiles(51);
    startHost();
    openDialog();
    mDesktop->dropFiles(files, inDialog(kStartupSuiteBox));
    answerAlert("27-fifty-one-files-dropped-on-the-box");
    closeDialog();
    quit();
    EXPECT_THAT(stored(suiteKey(), "NumStartup"), HasSubstr("0"));
}
