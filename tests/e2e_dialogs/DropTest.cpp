// Files dragged from a program of another toolkit, and from the dialog's own list.
#include "tests/e2e_dialogs/DialogTest.h"

using testing::HasSubstr;
using testing::Not;

class DialogDrop : public DialogTest
{
protected:
    static constexpr Place kTable = places::tableRow(4);

    std::string listOf(const std::vector<std::string>& paths) const
    {
        std::string list = "NumStartup = " + std::to_string(paths.size()) + "\n";
        for (std::size_t index = 0; index < paths.size(); ++index)
            list += std::to_string(index + 1) + "Startup = " + paths[index] + "\n";
        return list;
    }

    // From the middle of a row to the place at its edge where it stands for a gap.
    static constexpr int kEdge = 7;

    static constexpr Place edgeOf(int row, int fromMiddle)
    {
        return {places::tableRow(row).x, places::tableRow(row).y + fromMiddle};
    }

    // Opens the dialog with the first three files loaded.
    void loadThree(const std::vector<std::string>& paths)
    {
        storeSuite({paths[0], paths[1], paths[2]});
        open();
    }

    // What is said when more are dropped than can be taken.
    void dropFiftyOne(Place place)
    {
        const auto paths = writeManyLisp(51);
        open();
        dragFiles(paths, place, [this] { dismissMessageBox(); });
        const std::string output = closeAndEnd();
        EXPECT_THAT(output, Not(HasSubstr("many")));
    }
};

TEST_F(DialogDrop, LoadsTwoFilesDroppedOnTheTable)
{
    const auto paths = writeManyLisp(2);
    open();
    dragFiles(paths, kTable, [this] { EXPECT_TRUE(prints("2 applications were loaded.\n")); });
    shoot("loaded");
    const std::string output = closeAndEnd();
    EXPECT_THAT(output, HasSubstr("many1.lsp runs"));
    EXPECT_THAT(output, HasSubstr("many2.lsp runs"));
}

TEST_F(DialogDrop, LoadsAFileWhoseNameIsNoText)
{
    const auto file = mSession.folder().write("files/odd\xFF #%41.lsp", "(write-line \"odd Lisp runs\")\n");
    open();
    dragFiles({file.string()}, kTable, [this] { EXPECT_TRUE(prints(wasLoaded("odd\\xFF #%41.lsp"))); });
    EXPECT_THAT(closeAndEnd(), HasSubstr("odd Lisp runs"));
}

TEST_F(DialogDrop, LoadsFiftyFilesDroppedOnTheTable)
{
    const auto paths = writeManyLisp(50);
    open();
    dragFiles(paths, kTable, [this] { EXPECT_TRUE(prints("50 applications were loaded.\n")); });
    shoot("loaded");
    const std::string output = closeAndEnd();
    for (int number = 1; number <= 50; ++number)
        EXPECT_THAT(output, HasSubstr("many" + std::to_string(number) + ".lsp runs"));
}

TEST_F(DialogDrop, TakesNoneOfFiftyOneFilesDroppedOnTheTable)
{
    dropFiftyOne(kTable);
}

TEST_F(DialogDrop, TakesTwoFilesIntoTheStartupSuite)
{
    const auto paths = writeManyLisp(2);
    open();
    dragFiles(paths, places::kStartupSuiteBox,
              [this] { EXPECT_TRUE(prints("2 applications were added to the Startup Suite.\n")); });
    shoot("added");
    EXPECT_THAT(closeAndEnd(), HasSubstr("many2.lsp runs"));
    EXPECT_EQ(stored("Startup"), listOf(paths));
}

TEST_F(DialogDrop, TakesFiftyFilesIntoTheStartupSuite)
{
    const auto paths = writeManyLisp(50);
    open();
    dragFiles(paths, places::kStartupSuiteBox,
              [this] { EXPECT_TRUE(prints("50 applications were added to the Startup Suite.\n")); });
    shoot("added");
    closeAndEnd();
    EXPECT_EQ(stored("Startup"), listOf(paths));
}

TEST_F(DialogDrop, TakesNoneOfFiftyOneFilesIntoTheStartupSuite)
{
    dropFiftyOne(places::kStartupSuiteBox);
    EXPECT_THAT(stored("Startup"), Not(HasSubstr("many")));
}

TEST_F(DialogDrop, TakesAFileOfItsOwnListIntoTheStartupSuite)
{
    const std::string path = writeLisp("a.lsp");
    open();
    mScreen.drag(mDialog, places::file(0), mDialog, places::kStartupSuiteBox);
    EXPECT_TRUE(prints("a.lsp was added to the Startup Suite.\n"));
    shoot("added");
    closeAndEnd();
    EXPECT_EQ(stored("Startup"), listOf({path}));
}

TEST_F(DialogDrop, OfItsOwnListIsGivenUpByEscape)
{
    writeLisp("a.lsp");
    writeLisp("b.lsp");
    open();
    const Place table{kTable.x, kTable.y};
    const Place edge{places::kStartupSuiteBox.x, places::kStartupSuiteBox.y + 20};
    const std::string before = look(edge);
    for (const Place place : {places::kStartupSuiteBox, table})
    {
        mScreen.dragOver(mDialog, places::file(0), mDialog, place);
        shoot("hovering");
        EXPECT_EQ(look(edge) != before, place.y != table.y) << "where it would land is seen";
        mScreen.key("Escape");
        EXPECT_TRUE(comesTrue([&] { return look(edge) == before; }));
        mScreen.moveOn(mDialog, edge); // with the button still down
        EXPECT_EQ(look(edge), before);
        shoot("given-up");
        mScreen.letGo();
    }
    loadFile(1, "b.lsp");
    mScreen.drag(mDialog, places::file(1), mDialog, places::kStartupSuiteBox);
    EXPECT_TRUE(prints("b.lsp was added to the Startup Suite.\n"));
    EXPECT_THAT(closeAndEnd(), Not(HasSubstr("a.lsp")));
    EXPECT_EQ(stored("Startup"), listOf({(files() / "b.lsp").string()}));
}

TEST_F(DialogDrop, LoadsTwoFilesOfItsOwnListBetweenTheRowsOfTheTable)
{
    writeLisp("a.lsp");
    writeLisp("b.lsp");
    writeLisp("c.lsp");
    open();
    mScreen.doubleClick(mDialog, places::file(2));
    ASSERT_TRUE(prints(wasLoaded("c.lsp")));
    click(places::file(0));
    mScreen.clickHolding("shift", mDialog, places::file(1));
    const Place row = places::tableRow(0);
    mScreen.drag(mDialog, places::file(1), mDialog, {row.x, row.y - places::kTableRowHeight / 2 + 1});
    EXPECT_TRUE(prints("2 applications were loaded.\n"));
    shoot("loaded");
    closeAndEnd();
}

TEST_F(DialogDrop, IsTakenAnywhereInTheEmptyPartOfTheTableAfterThePointerCameOverTheRows)
{
    const auto paths = writeManyLisp(5);
    open();
    dragFiles({paths[0], paths[1]}, kTable, [this] { EXPECT_TRUE(prints("2 applications were loaded.\n")); });
    for (const int file : {2, 3, 4})
    {
        const auto source = dragSource({paths[static_cast<std::size_t>(file)]});
        mScreen.dragOver(dragWindow(), kDragButton, mDialog, places::tableRow(0));
        for (int row = 1; row <= 3 + file / 2; ++row)
            mScreen.moveOn(mDialog, {places::tableRow(row).x, places::tableRow(row).y + 3 * file});
        shoot("hovering-" + std::to_string(file));
        mScreen.letGo();
        EXPECT_TRUE(prints(wasLoaded("many" + std::to_string(file + 1) + ".lsp")));
    }
    closeAndEnd();
}

TEST_F(DialogDrop, IsTakenBetweenTwoRows)
{
    const auto paths = writeManyLisp(3);
    open();
    dragFiles({paths[0], paths[1]}, kTable, [this] { EXPECT_TRUE(prints("2 applications were loaded.\n")); });
    const Place between{places::tableRow(1).x, places::tableRow(1).y - places::kTableRowHeight / 2};
    dragFiles({paths[2]}, between, [this] { EXPECT_TRUE(prints(wasLoaded("many3.lsp"))); });
    shoot("between");
    closeAndEnd();
}

// What hovers over a row, from its upper edge on, and is dropped at its lower edge lands below the row.
TEST_F(DialogDrop, LandsBelowTheRowWhoseLowerEdgeItHoversOver)
{
    const auto paths = writeManyLisp(4);
    loadThree(paths);
    const std::string first = look(places::tableRow(0));
    const std::string second = look(places::tableRow(1));
    const std::string third = look(places::tableRow(2));
    auto source = dragSource({paths[3]});
    mScreen.dragOver(dragWindow(), kDragButton, mDialog, edgeOf(1, -kEdge));
    shoot("upper-edge");
    mScreen.moveOn(mDialog, edgeOf(1, kEdge));
    shoot("lower-edge");
    mScreen.letGo();
    EXPECT_TRUE(prints(wasLoaded("many4.lsp")));
    shoot("landed");
    source.reset(); // which gives the keyboard back
    EXPECT_EQ(look(places::tableRow(0)), first);
    EXPECT_EQ(look(places::tableRow(1)), second);
    EXPECT_NE(look(places::tableRow(2)), third);
    EXPECT_EQ(look(places::tableRow(3)), third);
    closeAndEnd();
}

TEST_F(DialogDrop, LandsAtTheEndWhenItHoversOverTheLowerEdgeOfTheLastRow)
{
    const auto paths = writeManyLisp(4);
    loadThree(paths);
    const std::string third = look(places::tableRow(2));
    const std::string empty = look(places::tableRow(3));
    dragFiles({paths[3]}, edgeOf(2, kEdge), [this] { EXPECT_TRUE(prints(wasLoaded("many4.lsp"))); });
    shoot("landed");
    EXPECT_EQ(look(places::tableRow(2)), third);
    EXPECT_NE(look(places::tableRow(3)), empty);
    closeAndEnd();
}

TEST_F(DialogDrop, IsNotTakenByTheMiddleOfARowWhichIsNotMarked)
{
    const auto paths = writeManyLisp(4);
    loadThree(paths);
    const Place gap = edgeOf(1, -places::kTableRowHeight / 2);
    const std::string unmarked = look(gap);
    const std::string row = look(places::tableRow(1));
    auto source = dragSource({paths[3]});
    mScreen.dragOver(dragWindow(), kDragButton, mDialog, edgeOf(1, -kEdge));
    EXPECT_NE(look(gap), unmarked);
    mScreen.moveOn(mDialog, {places::tableRow(1).x, places::tableRow(1).y - 1});
    shoot("hovering");
    EXPECT_EQ(look(gap), unmarked);
    EXPECT_EQ(look(places::tableRow(1)), row);
    mScreen.letGo();
    source.reset();
    EXPECT_THAT(closeAndEnd(), Not(HasSubstr("many4.lsp was loaded")));
}

TEST_F(DialogDrop, IsNotTakenByADialogBehindAMessageBox)
{
    writeBroken("aaa.zmb");
    const auto paths = writeManyLisp(1);
    open();
    loadBroken(0);
    dragFiles(paths, {kTable.x, kTable.y + 80}, [this] { shoot("refused"); });
    dragFiles(paths, {places::kStartupSuiteBox.x, places::kStartupSuiteBox.y + 20}, [] {});
    dismissMessageBox();
    EXPECT_THAT(closeAndEnd(), Not(HasSubstr("many1.lsp")));
}

TEST_F(DialogDrop, LetsItsSourceGoBeforeAMessageBoxIsAnswered)
{
    const auto paths = writeManyLisp(51);
    open();
    auto source = dragSource(paths);
    mScreen.drag(dragWindow(), kDragButton, mDialog, kTable);
    ASSERT_FALSE(mScreen.waitForWindow(kMessageBox).empty());
    EXPECT_TRUE(comesTrue([&] { return source->output().find("has ended") != std::string::npos; }));
    EXPECT_FALSE(mScreen.window(kMessageBox).empty());
    source.reset(); // and it may end
    dismissMessageBox();
    EXPECT_THAT(closeAndEnd(), Not(HasSubstr("X-Windows")));
}

TEST_F(DialogDrop, IsShownByTheStartupSuiteBoxWhileItWouldBeTaken)
{
    const auto paths = writeManyLisp(1);
    open();
    const Place edge{places::kStartupSuiteBox.x, places::kStartupSuiteBox.y + 20};
    const std::string before = look(edge);
    auto source = dragSource(paths);
    mScreen.dragOver(dragWindow(), kDragButton, mDialog, {edge.x, edge.y + 30});
    shoot("hovering");
    EXPECT_NE(look(edge), before);
    mScreen.letGo();
    EXPECT_TRUE(prints("many1.lsp was added to the Startup Suite.\n"));
    EXPECT_TRUE(comesTrue([&] { return look(edge) == before; }));
    shoot("taken");
    source.reset(); // which gives the keyboard back
    closeAndEnd();
}
