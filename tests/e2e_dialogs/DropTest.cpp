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
    mScreen.drag(mDialog, places::file(1), mDialog, {row.x, row.y - places::kRowHeight / 2 + 1});
    EXPECT_TRUE(prints("2 applications were loaded.\n"));
    shoot("loaded");
    closeAndEnd();
}
