// The table of what is loaded, and unloading from it.
#include "tests/e2e_dialogs/DialogTest.h"

using testing::HasSubstr;
using testing::Not;

class DialogLoadedApplications : public DialogTest
{
};

TEST_F(DialogLoadedApplications, UnloadsTheSelectedRow)
{
    copySample("gears.omp");
    open();
    loadFile(0, "gears.omp");
    click(places::tableRow(0));
    click(places::kUnload);
    EXPECT_TRUE(prints("gears.omp was unloaded.\n"));
    shoot("unloaded");
    EXPECT_THAT(closeAndEnd(), Not(HasSubstr(listedIn("gears.omp", files()))));
}

TEST_F(DialogLoadedApplications, DoesNotSelectALoadedFileThatCannotBeUnloaded)
{
    writeLisp("z.lsp");
    open();
    const std::string buttonBefore = look(places::kUnload);
    loadFile(0, "z.lsp");
    const std::string boxBefore = look(places::kAddToHistory);
    click(places::kAddToHistory); // shows that the load has been dealt with
    ASSERT_TRUE(changes(places::kAddToHistory, boxBefore));
    shoot("loaded");
    EXPECT_EQ(look(places::kUnload), buttonBefore) << "Unload is enabled";
    closeAndEnd();
}

TEST_F(DialogLoadedApplications, DoesNotSelectARowThatCannotBeUnloaded)
{
    storeSuite({writeLisp("z.lsp"), copySample("gears.omp")});
    open();
    const std::string rowBefore = look(places::tableRow(1));
    const std::string buttonBefore = look(places::kUnload);
    const std::string boxBefore = look(places::kAddToHistory);
    click(places::tableRow(1));   // Lisp stays loaded
    click(places::kAddToHistory); // shows that the click before it has been dealt with
    ASSERT_TRUE(changes(places::kAddToHistory, boxBefore));
    shoot("clicked");
    EXPECT_EQ(look(places::tableRow(1)), rowBefore) << "the row is drawn selected";
    EXPECT_EQ(look(places::kUnload), buttonBefore) << "Unload is enabled";
    click(places::tableRow(0));
    EXPECT_TRUE(changes(places::kUnload, buttonBefore)) << "Unload is disabled";
    shoot("selected");
    click(places::kUnload);
    EXPECT_TRUE(prints("gears.omp was unloaded.\n"));
    shoot("unloaded");
    const std::string output = closeAndEnd();
    EXPECT_THAT(output, Not(HasSubstr("z.lsp was")));
    EXPECT_THAT(output, HasSubstr(listedIn("z.lsp", files())));
    EXPECT_THAT(output, Not(HasSubstr(listedIn("gears.omp", files()))));
}
