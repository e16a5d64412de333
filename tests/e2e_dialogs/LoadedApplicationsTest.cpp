// The table of what is loaded, and unloading from it.
#include "tests/e2e_dialogs/DialogTest.h"

using testing::HasSubstr;
using testing::Not;

class DialogLoadedApplications : public DialogTest
{
protected:
    void loadFirstFile(const std::string& name)
    {
        click(places::file(0));
        click(places::kLoad);
        ASSERT_TRUE(prints(wasLoaded(name)));
    }
};

TEST_F(DialogLoadedApplications, UnloadsTheSelectedRow)
{
    copySample("gears.omp");
    open();
    loadFirstFile("gears.omp");
    click(places::tableRow(0));
    click(places::kUnload);
    EXPECT_TRUE(prints("gears.omp was unloaded.\n"));
    shoot("unloaded");
    EXPECT_THAT(closeAndEnd(), Not(HasSubstr(listedIn("gears.omp", files()))));
}

TEST_F(DialogLoadedApplications, DoesNotSelectARowThatCannotBeUnloaded)
{
    storeSuite({writeLisp("z.lsp")});
    copySample("gears.omp");
    open();
    loadFirstFile("gears.omp");
    click(places::tableRow(0)); // Lisp stays loaded
    shoot("clicked");
    click(places::kUnload);
    click(places::tableRow(1));
    shoot("selected");
    click(places::kUnload);
    EXPECT_TRUE(prints("gears.omp was unloaded.\n"));
    shoot("unloaded");
    const std::string output = closeAndEnd();
    EXPECT_THAT(output, Not(HasSubstr("z.lsp was")));
    EXPECT_THAT(output, HasSubstr(listedIn("z.lsp", files())));
    EXPECT_THAT(output, Not(HasSubstr(listedIn("gears.omp", files()))));
}
