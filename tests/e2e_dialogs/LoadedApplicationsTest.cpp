// The table of what is loaded, and unloading from it.
#include "tests/e2e_dialogs/DialogTest.h"

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
