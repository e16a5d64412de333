// Showing a page in the person's browser, a program that the session starts and forgets.
#include <gtest/gtest.h>

#include <fstream>
#include <iterator>

#include <sys/stat.h>
#include <sys/wait.h>

#include "host/messages/Browser.h"
#include "host/messages/platform/Desktop.h"
#include "tests/support/EnvironmentVariable.h"
#include "tests/support/ShellProgram.h"

namespace fs = std::filesystem;

using tessel::openInBrowser;
using tessel::pageOpeners;

namespace
{
class Browser : public testing::Test
{
protected:
    Browser() { mkfifo(mNote.c_str(), 0600); }

    // A program that tells which page it was given, and then does not end before somebody has read it.
    void install(const std::string& name, bool runs = true)
    {
        const auto program = writeProgram(mFolder, "programs/" + name,
                                          "printf '%s in " + name + "' \"$1\" >'" + mNote.string() + "'");
        if (!runs)
            fs::permissions(program, fs::perms::owner_read);
    }

    std::string opened() const
    {
        std::ifstream note(mNote);
        return {std::istreambuf_iterator<char>(note), {}};
    }

private:
    TemporaryFolder mFolder;
    fs::path mNote = mFolder / "note";
    EnvironmentVariable mPath{"PATH", (mFolder / "programs").string()};
    EnvironmentVariable mDisplay{"DISPLAY", ":0"};
};
} // namespace

TEST_F(Browser, IsGivenThePageWithWhateverNameItHas)
{
    install(pageOpeners().front());
    ASSERT_TRUE(openInBrowser("/help/a \"b\" $c 'd'.html"));
    EXPECT_EQ(opened(), "/help/a \"b\" $c 'd'.html in " + pageOpeners().front());
}

TEST_F(Browser, IsTheFirstOneThatIsThere)
{
    for (const std::string& name : pageOpeners())
        install(name);
    ASSERT_TRUE(openInBrowser("/page.html"));
    EXPECT_EQ(opened(), "/page.html in " + pageOpeners().front());
}

TEST_F(Browser, IsTheNextOneWhereAnotherIsMissingOrIsNoProgram)
{
    install(pageOpeners().front(), pageOpeners().size() == 1);
    install(pageOpeners().back());
    ASSERT_TRUE(openInBrowser("/page.html"));
    EXPECT_EQ(opened(), "/page.html in " + pageOpeners().back());
}

TEST_F(Browser, IsPutAwayWhenTheNextOneStarts)
{
    install(pageOpeners().front());
    ASSERT_TRUE(openInBrowser("/one.html"));
    opened();
    siginfo_t ended{};
    ASSERT_EQ(waitid(P_ALL, 0, &ended, WEXITED | WNOWAIT), 0);
    ASSERT_TRUE(openInBrowser("/two.html"));
    opened();
    const pid_t second = waitpid(-1, nullptr, 0);
    EXPECT_GT(second, 0);
    EXPECT_NE(second, ended.si_pid);
    EXPECT_EQ(waitpid(-1, nullptr, 0), -1);
}

TEST_F(Browser, IsSoughtInNoPlaceWhenThePathIsEmpty)
{
    const EnvironmentVariable path("PATH", "");
    EXPECT_FALSE(openInBrowser("/page.html"));
}

TEST_F(Browser, ThatIsNotThereOpensNothing)
{
    EXPECT_FALSE(openInBrowser("/page.html"));
    install(pageOpeners().front(), false);
    EXPECT_FALSE(openInBrowser("/page.html"));
}
