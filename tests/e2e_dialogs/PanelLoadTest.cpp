// Loading files that are chosen in the panel.
#include "tests/e2e_dialogs/DialogTest.h"

using testing::AllOf;
using testing::HasSubstr;
using testing::Not;

class DialogPanelLoad : public DialogTest
{
protected:
    // With Add to History switched on.
    void loadGearsAndPrimesTogether()
    {
        copySample("gears.omp");
        copySample("primes.zmb");
        open();
        click(places::kAddToHistory);
        loadFirstTwoTogether();
    }

    void loadFirstTwoTogether() const
    {
        click(places::file(0));
        mScreen.clickHolding("shift", mDialog, places::file(1));
        shoot("selected");
        click(places::kLoad);
        EXPECT_TRUE(prints("2 applications were loaded.\n"));
        shoot("loaded");
    }
};

TEST_F(DialogPanelLoad, LoadsTwoFilesThatAreSelectedTogether)
{
    loadGearsAndPrimesTogether();
    const std::string output = closeAndEnd();
    EXPECT_THAT(output, HasSubstr(listedIn("gears.omp", files())));
    EXPECT_THAT(output, HasSubstr(listedIn("primes.zmb", files())));
    EXPECT_EQ(stored("History"), "NumHistory = 2\n1History = " + (files() / "gears.omp").string() +
                                     "\n2History = " + (files() / "primes.zmb").string() + "\n");
}

// Each row does what only its own file can have done.
TEST_F(DialogPanelLoad, ShowsTwoLoadedFilesInBothTables)
{
    loadGearsAndPrimesTogether();
    click(places::tableRow(0));
    click(places::kUnload);
    EXPECT_TRUE(prints("gears.omp was unloaded.\n"));
    shoot("first-unloaded");
    click(places::tableRow(0)); // the second file has moved up
    click(places::kUnload);
    EXPECT_TRUE(prints("primes.zmb was unloaded.\n"));
    shoot("second-unloaded");
    click(places::kHistoryTab);
    shoot("history");
    mScreen.doubleClick(mDialog, places::tableRow(0));
    EXPECT_TRUE(prints(wasLoaded("gears.omp")));
    mScreen.doubleClick(mDialog, places::tableRow(1));
    EXPECT_TRUE(prints(wasLoaded("primes.zmb")));
    shoot("loaded-again");
    closeAndEnd();
}

TEST_F(DialogPanelLoad, ReturnLoadsTheFileWhoseNameIsTyped)
{
    writeLisp("typed.lsp");
    open();
    typeName("typed.lsp");
    shoot("typed");
    mScreen.key("Return");
    EXPECT_TRUE(prints(wasLoaded("typed.lsp")));
    shoot("loaded");
    const std::string output = closeAndEnd();
    EXPECT_THAT(output, HasSubstr("typed.lsp runs"));
    EXPECT_THAT(output, HasSubstr(listedIn("typed.lsp", files())));
}

TEST_F(DialogPanelLoad, LoadsTheFileWhoseNameIsTyped)
{
    writeLisp("typed.lsp");
    open();
    typeName("typed.lsp");
    shoot("typed");
    click(places::kLoad);
    EXPECT_TRUE(prints(wasLoaded("typed.lsp")));
    shoot("loaded");
    EXPECT_THAT(closeAndEnd(), HasSubstr("typed.lsp runs"));
}

TEST_F(DialogPanelLoad, ReturnLoadsTheFileThatIsSelected)
{
    writeLisp("chosen.lsp");
    open();
    click(places::file(0));
    mScreen.key("Return");
    EXPECT_TRUE(prints(wasLoaded("chosen.lsp")));
    shoot("loaded");
    EXPECT_THAT(closeAndEnd(), HasSubstr("chosen.lsp runs"));
}

TEST_F(DialogPanelLoad, LoadsAFileByADoubleClick)
{
    writeLisp("a.lsp");
    writeLisp("b.lsp");
    open();
    mScreen.doubleClick(mDialog, places::file(1));
    EXPECT_TRUE(prints(wasLoaded("b.lsp")));
    shoot("loaded");
    const std::string output = closeAndEnd();
    EXPECT_THAT(output, HasSubstr("b.lsp runs"));
    EXPECT_EQ(output.find("b.lsp runs"), output.rfind("b.lsp runs")) << "once: " << output;
    EXPECT_THAT(output, Not(HasSubstr("a.lsp")));
}

TEST_F(DialogPanelLoad, SaysThatAFileIsLoadedAlready)
{
    copySample("gears.omp");
    open();
    loadFile(0, "gears.omp");
    click(places::kLoad);
    EXPECT_TRUE(prints("gears.omp is already loaded.\n"));
    shoot("already-loaded");
    const std::string output = closeAndEnd();
    const std::string listed = listedIn("gears.omp", files());
    EXPECT_THAT(output, HasSubstr(listed));
    EXPECT_EQ(output.find(listed), output.rfind(listed)) << "one entry: " << output;
}

TEST_F(DialogPanelLoad, StopsAtTheFileThatCannotBeLoaded)
{
    writeLisp("a.lsp");
    writeBroken("b.zmb");
    writeLisp("c.lsp");
    open();
    click(places::file(0));
    mScreen.clickHolding("shift", mDialog, places::file(1));
    mScreen.clickHolding("shift", mDialog, places::file(2));
    shoot("selected");
    click(places::kLoad);
    dismissMessageBox();
    shoot("stopped");
    const std::string output = closeAndEnd();
    EXPECT_THAT(output, HasSubstr(listedIn("a.lsp", files())));
    EXPECT_THAT(output, HasSubstr("a.lsp runs"));
    EXPECT_THAT(output, HasSubstr("b.zmb\" is not loaded: "));
    EXPECT_THAT(output, HasSubstr("Not loaded in this session:\n" + listedIn("b.zmb", files())));
    EXPECT_THAT(output, Not(HasSubstr("c.lsp")));
    EXPECT_THAT(output, Not(HasSubstr("loaded.\n"))) << "nothing was completed that could be summed up";
}

// Names that another system wrote in another encoding.
TEST_F(DialogPanelLoad, LoadsFilesWhoseNamesAreNoTextAndFindsThemAgain)
{
    mSession.folder().write("files/r\xE9pertoire/odd\xFF.lsp", "(write-line \"odd Lisp runs\")\n");
    std::filesystem::copy(std::filesystem::path(SAMPLES_FOLDER) / "gears.omp",
                          files() / "r\xE9pertoire/gears\xFE.omp");
    open();
    click(places::kAddToHistory);
    mScreen.doubleClick(mDialog, places::file(0)); // into the folder
    shoot("folder");
    loadFirstTwoTogether();
    click(places::kHistoryTab);
    click(places::tableRow(0));
    click(places::kAddToStartupSuite);
    EXPECT_TRUE(prints("gears\\xFE.omp was added to the Startup Suite.\n"));
    shoot("suite");
    EXPECT_THAT(closeAndEnd(), AllOf(HasSubstr("odd Lisp runs"), HasSubstr("  gears\\xFE.omp ")));
    const std::string shownFolder = files().string() + "/r\\xE9pertoire/";
    EXPECT_EQ(stored("History"), "NumHistory = 2\n1History = " + shownFolder +
                                     "gears\\xFE.omp\n2History = " + shownFolder + "odd\\xFF.lsp\n");
    EXPECT_EQ(stored("Startup"), "NumStartup = 1\n1Startup = " + shownFolder + "gears\\xFE.omp\n");

    open(); // with the History in front
    mScreen.doubleClick(mDialog, places::tableRow(1));
    EXPECT_TRUE(prints(wasLoaded("odd\\xFF.lsp")));
    EXPECT_THAT(closeAndEnd(), AllOf(HasSubstr("odd Lisp runs"), HasSubstr("  gears\\xFE.omp ")));
}

TEST_F(DialogPanelLoad, OpensWithTheColumnsAndTheHiddenFilesThatItWasLeftWith)
{
    writeLisp(".hidden.lsp");
    open();
    click(places::kHiddenFiles);
    mScreen.drag(mDialog, places::kEndOfNames, mDialog, {places::kEndOfNames.x - 100, places::kEndOfNames.y});
    shoot("left");
    const std::string kinds = look({places::kEndOfNames.x - 80, places::file(0).y});
    closeAndEnd();
    open();
    shoot("again");
    EXPECT_EQ(look({places::kEndOfNames.x - 80, places::file(0).y}), kinds);
    loadFile(0, ".hidden.lsp");
    closeAndEnd();
    const std::string width = runQuietly(
        {R"(REGISTRY GET Software\Tessel\R21\Profiles\Default\DialogSettings\FilePanel kindWidth)"});
    EXPECT_THAT(width, HasSubstr("\n2")) << "some hundred points more than before: " << width;
}

TEST_F(DialogPanelLoad, ShowsTheFilesOfTheChosenTypeOnly)
{
    copySample("gears.omp");
    writeLisp("z.lsp");
    open();
    mScreen.choose(mDialog, places::kFileTypes, {places::kFileTypes.x, places::kFileTypes.y + 3 * 26});
    shoot("lisp-only");
    loadFile(0, "z.lsp"); // where gears.omp has been
    mScreen.choose(mDialog, places::kFileTypes, {places::kFileTypes.x, places::kFileTypes.y - 3 * 26});
    shoot("all-types");
    loadFile(0, "gears.omp");
    EXPECT_THAT(closeAndEnd(), HasSubstr("z.lsp runs"));
}

TEST_F(DialogPanelLoad, LoadsNothingThatTheChosenTypeHides)
{
    copySample("gears.omp");
    writeLisp("z.lsp");
    open();
    click(places::file(0));
    shoot("selected");
    mScreen.choose(mDialog, places::kFileTypes, {places::kFileTypes.x, places::kFileTypes.y + 3 * 26});
    click(places::kLoad);
    shoot("hidden");
    const std::string output = closeAndEnd();
    EXPECT_THAT(output, Not(HasSubstr("loaded.\n")));
    EXPECT_THAT(output, Not(HasSubstr("gears.omp")));
}
