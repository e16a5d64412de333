// The dialogs for a person whose language is German, on a system that has no data of it.
#include "tests/e2e_dialogs/DialogTest.h"

#include <cstdio>

using testing::HasSubstr;

namespace
{
constexpr char kGermanDialog[] = "Anwendungen laden/entladen";
constexpr char kGermanSuite[] = "Startgruppe";
constexpr char kGermanAddPanel[] = "Zur Startgruppe hinzufügen";
constexpr Place kGermanHistoryTab{245, 410};
} // namespace

class GermanDialog : public DialogTest
{
protected:
    explicit GermanDialog(DisplayKind kind = {}) : DialogTest(kind)
    {
        mSession.set("LC_ALL", "");
        mSession.set("LANGUAGE", "");
        mSession.set("LANG", "de_DE.UTF-8");
    }

    void openGerman()
    {
        mHost = std::make_unique<Program>(mSession.commandLine({}), mSession.environment(),
                                          mSession.folder() / "output.txt");
        mHost->type("MODRIG");
        mDialog = mScreen.waitForActive(kGermanDialog);
        ASSERT_FALSE(mDialog.empty()) << mHost->output();
        shoot("opened");
    }

    void closeGerman()
    {
        ASSERT_TRUE(mScreen.waitUntilActive(mDialog));
        mScreen.key("Escape");
        EXPECT_TRUE(mScreen.waitUntilGone(kGermanDialog));
    }
};

TEST_F(GermanDialog, OpensAndSaysWhatItHasDone)
{
    const std::string lisp = writeLisp("eins.lsp");
    storeHistory({lisp, copySample("primes.zmb")});
    openGerman();
    click(kGermanHistoryTab);
    shoot("history");
    click(places::tableRow(1));
    click(places::kLoadFromHistory);
    EXPECT_TRUE(prints("primes.zmb wurde geladen.\n"));
    shoot("loaded");
    closeGerman();
}

TEST_F(GermanDialog, ShowsMessageBoxes)
{
    writeBroken("kaputt.zmb");
    openGerman();
    loadBroken(0);
    const std::string box = mScreen.waitForActive(kMessageBox);
    ASSERT_FALSE(box.empty());
    shoot("box");
    mScreen.key("Return");
    EXPECT_TRUE(mScreen.waitUntilGone(kMessageBox));
    closeGerman();
}

TEST_F(GermanDialog, OpensItsHelpPages)
{
    EXPECT_THAT(mSession.run({"HELP startup_suite_dialog"}).output,
                HasSubstr("/Resources/help/de/startup_suite_dialog.html\n"));
}

TEST_F(GermanDialog, SpeaksEnglishToWhomTheOtherLanguagesAreUnknown)
{
    mSession.set("LANG", "fr_FR.UTF-8");
    open();
    closeAndEnd();
}

TEST_F(GermanDialog, OpensTheWindowsOfTheStartupSuite)
{
    storeSuite({writeLisp("eins.lsp"), (files() / "fort.lsp").string()});
    openGerman();
    click(places::kContents);
    const std::string suite = mScreen.waitForActive(kGermanSuite);
    ASSERT_FALSE(suite.empty());
    shoot("suite");
    mScreen.key("Insert");
    EXPECT_FALSE(mScreen.waitForActive(kGermanAddPanel).empty());
    shoot("add");
    mScreen.key("Escape");
    EXPECT_TRUE(mScreen.waitUntilGone(kGermanAddPanel));
    mScreen.key("Escape");
    EXPECT_TRUE(mScreen.waitUntilGone(kGermanSuite));
    closeGerman();
}

TEST_F(GermanDialog, IsGermanWhateverLanguageIsSetForTheToolkit)
{
    setToolkitSetting("NSLanguages", "French");
    openGerman();
    closeGerman();
}

namespace
{
class GermanDialogOnLowScreens : public GermanDialog
{
protected:
    GermanDialogOnLowScreens() : GermanDialog({.width = 800, .height = 600}) {}
};

class GermanDialogEnlarged : public GermanDialog
{
protected:
    GermanDialogEnlarged() : GermanDialog({.width = 2000, .height = 1600}) {}
};
} // namespace

TEST_F(GermanDialogOnLowScreens, FitsThem)
{
    storeHistory({writeLisp("eins.lsp")});
    setSetting("LastTab", "1");
    openGerman();
    int width = 0;
    int height = 0;
    ASSERT_EQ(2, std::sscanf(mScreen.sizeOf(mDialog).c_str(), "%dx%d", &width, &height));
    EXPECT_LE(width, 800);
    EXPECT_LE(height, 600);
    closeGerman();
}

TEST_F(GermanDialogEnlarged, IsAsLargeAsInEnglish)
{
    setToolkitSetting("GSScaleFactor", "1.5");
    storeHistory({writeLisp("eins.lsp")});
    setSetting("LastTab", "1");
    openGerman();
    int width = 0;
    ASSERT_EQ(1, std::sscanf(mScreen.sizeOf(mDialog).c_str(), "%dx", &width));
    EXPECT_NEAR(width, places::kDialogWidth * 1.5, 3);
    closeGerman();
}
