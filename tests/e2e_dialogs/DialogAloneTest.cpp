// The dialog without a prompt, as an entry of a desktop's menu opens it.
#include <sys/resource.h>
#include <sys/stat.h>

#include "tests/e2e_dialogs/DialogTest.h"

using testing::Optional;

class DialogAlone : public DialogTest
{
protected:
    // As the Startup Suite of everybody; `place`: below the folder of what is laid out.
    void layOutSuite(const std::string& place, const std::string& file)
    {
        mSession.folder().write("layout/" + place,
                                "Windows Registry Editor Version 5.00\n\n[HKEY_CURRENT_USER\\" +
                                    std::string(kDialogsKey) +
                                    "\\Startup]\n\"NumStartup\"=\"1\"\n\"1Startup\"=\"" + file + "\"\n");
        mSession.alwaysWith({"--layout-dir", (mSession.folder() / "layout").string()});
    }

    void openAlone(const std::vector<std::string>& arguments)
    {
        mHost = std::make_unique<Program>(mSession.commandLine(arguments), mSession.environment(),
                                          mSession.folder() / "output.txt");
        mDialog = mScreen.waitForActive(kDialog);
        ASSERT_FALSE(mDialog.empty()) << mHost->output();
    }

    // Closes so many boxes, which come one after the other.
    void dismissMessageBoxes(int count)
    {
        std::string before;
        for (int number = 1; number <= count; ++number)
        {
            std::string box;
            ASSERT_TRUE(comesTrue([&] { return (box = mScreen.waitForActive(kMessageBox)) != before; }));
            ASSERT_FALSE(box.empty()) << "there is no box " << number;
            shoot("box-" + std::to_string(number));
            press("Return");
            before = box;
        }
    }
};

TEST_F(DialogAlone, OpensByItselfSaysNothingAndEndsTessel)
{
    openAlone({"--modrig"});
    press("Escape");
    EXPECT_THAT(mHost->waitForEnd(), Optional(0));
    EXPECT_EQ(mHost->output(), "");
}

// Who looks at the list has not made it theirs.
TEST_F(DialogAlone, LeavesASuiteThatIsLaidOutForEverybodyToTheAdministrator)
{
    layOutSuite("suite.reg", writeLisp("first.lsp"));
    openAlone({"--modrig"});
    press("Escape");
    EXPECT_THAT(mHost->waitForEnd(), Optional(0));
    layOutSuite("suite.reg", writeLisp("second.lsp"));
    const auto next = mSession.run({"APPS"});
    EXPECT_THAT(next.output, testing::HasSubstr("second.lsp runs"));
    EXPECT_THAT(next.output, testing::Not(testing::HasSubstr("first.lsp")));
}

// Nobody reads a command line there.
TEST_F(DialogAlone, SaysInAWindowThatWhatIsPolicyStays)
{
    layOutSuite("policy/suite.reg", writeLisp("first.lsp"));
    openAlone({"--modrig"});
    click(places::kContents);
    ASSERT_FALSE(mScreen.waitForActive(kSuiteDialog).empty());
    press("Down");
    press("Delete");
    press("Escape");
    ASSERT_TRUE(mScreen.waitUntilGone(kSuiteDialog));
    ASSERT_TRUE(mScreen.waitUntilActive(mDialog));
    press("Escape");
    ASSERT_FALSE(mScreen.waitForActive(kMessageBox).empty()) << mHost->output();
    shoot("told");
    press("Return");
    EXPECT_THAT(mHost->waitForEnd(), Optional(0));
    EXPECT_THAT(mHost->output(), testing::HasSubstr("are laid down by the administrator"));
}

// The module tells it of each of its two lists, and the host the reason.
TEST_F(DialogAlone, SaysInAWindowWhyNothingCouldBeStored)
{
    writeLisp("a.lsp");
    setSetting("SaveHistory", "1");
    openAlone({"--modrig"});
    loadFile(0, "a.lsp");
    const rlimit limit = {4096, RLIM_INFINITY};
    ASSERT_EQ(prlimit(mHost->process(), RLIMIT_FSIZE, &limit, nullptr), 0);
    press("Escape");
    dismissMessageBoxes(3);
    EXPECT_THAT(mHost->waitForEnd(), Optional(1));
    EXPECT_THAT(mHost->output(), testing::HasSubstr("registry.db could not be written: File too large."));
}

TEST_F(DialogAlone, SaysInAWindowThatNothingMayBeStored)
{
    setSetting("SaveHistory", "1");
    ASSERT_EQ(chmod((mSession.profile() / "registry.db").c_str(), S_IRUSR), 0);
    openAlone({"--modrig"});
    press("Escape");
    dismissMessageBoxes(3);
    EXPECT_THAT(mHost->waitForEnd(), Optional(0));
    EXPECT_THAT(mHost->output(), testing::HasSubstr("registry.db may only be read"));
}

TEST_F(DialogAlone, OpensAfterTheFilesThatWereNamedAreLoaded)
{
    const std::string file = copySample("primes.zmb");
    openAlone({"--modrig", file});
    press("Escape");
    EXPECT_THAT(mHost->waitForEnd(), Optional(0));
    EXPECT_EQ(mHost->output(), "Primes: type PRIMES to see them on a spiral.\n" + file + " is loaded.\n");
}
