// The History's table: loading from it and removing from it.
#include "tests/e2e_dialogs/DialogTest.h"

using testing::HasSubstr;
using testing::Not;

class DialogHistory : public DialogTest
{
protected:
    // A History of these files, in a dialog that shows it.
    void openWith(const std::vector<std::string>& names)
    {
        std::vector<std::string> paths;
        for (const auto& name : names)
            paths.push_back(writeLisp(name));
        openWithHistory(paths);
    }

    std::string path(const std::string& name) const { return (files() / name).string(); }
};

TEST_F(DialogHistory, LoadsTheSelectedRowByItsButton)
{
    openWith({"a.lsp", "b.lsp"});
    click(places::tableRow(1));
    shoot("selected");
    click(places::kLoadFromHistory);
    EXPECT_TRUE(prints(wasLoaded("b.lsp")));
    shoot("loaded");
    const std::string output = closeAndEnd();
    EXPECT_THAT(output, HasSubstr(listedIn("b.lsp", files())));
    EXPECT_THAT(output, Not(HasSubstr("a.lsp")));
}

TEST_F(DialogHistory, LoadsARowByADoubleClick)
{
    openWith({"a.lsp", "b.lsp"});
    mScreen.doubleClick(mDialog, places::tableRow(0));
    EXPECT_TRUE(prints(wasLoaded("a.lsp")));
    shoot("loaded");
    const std::string output = closeAndEnd();
    EXPECT_THAT(output, HasSubstr(listedIn("a.lsp", files())));
    EXPECT_THAT(output, Not(HasSubstr("b.lsp")));
}

TEST_F(DialogHistory, RemovesOneRow)
{
    openWith({"a.lsp", "b.lsp"});
    click(places::tableRow(0));
    click(places::kRemoveFromHistory);
    EXPECT_TRUE(prints("a.lsp was removed from the History list.\n"));
    shoot("removed");
    closeAndEnd();
    EXPECT_EQ(stored("History"), "NumHistory = 1\n1History = " + path("b.lsp") + "\n");
}

TEST_F(DialogHistory, RemovesThreeRowsAtOnce)
{
    openWith({"a.lsp", "b.lsp", "c.lsp", "d.lsp"});
    click(places::tableRow(0));
    mScreen.clickHolding("shift", mDialog, places::tableRow(3)); // a range
    mScreen.clickHolding("ctrl", mDialog, places::tableRow(1));  // without one of its rows
    shoot("selected");
    click(places::kRemoveFromHistory);
    EXPECT_TRUE(prints("3 entries were removed from the History list.\n"));
    shoot("removed");
    closeAndEnd();
    EXPECT_EQ(stored("History"), "NumHistory = 1\n1History = " + path("b.lsp") + "\n");
}
