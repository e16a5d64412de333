// The dialog without a prompt, as an entry of a desktop's menu opens it.
#include "tests/e2e_dialogs/DialogTest.h"

using testing::Optional;

class DialogAlone : public DialogTest
{
protected:
    void openAlone(const std::vector<std::string>& arguments)
    {
        mHost = std::make_unique<Program>(mSession.commandLine(arguments), mSession.environment(),
                                          mSession.folder() / "output.txt");
        mDialog = mScreen.waitForActive(kDialog);
        ASSERT_FALSE(mDialog.empty()) << mHost->output();
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
    const auto layOut = [this](const std::string& file)
    {
        mSession.folder().write("layout/suite.reg",
                                "Windows Registry Editor Version 5.00\n\n[HKEY_CURRENT_USER\\" +
                                    std::string(kDialogsKey) +
                                    "\\Startup]\n\"NumStartup\"=\"1\"\n\"1Startup\"=\"" + file + "\"\n");
    };
    mSession.alwaysWith({"--layout-dir", (mSession.folder() / "layout").string()});
    layOut(writeLisp("first.lsp"));
    openAlone({"--modrig"});
    press("Escape");
    EXPECT_THAT(mHost->waitForEnd(), Optional(0));
    layOut(writeLisp("second.lsp"));
    const auto next = mSession.run({"APPS"});
    EXPECT_THAT(next.output, testing::HasSubstr("second.lsp runs"));
    EXPECT_THAT(next.output, testing::Not(testing::HasSubstr("first.lsp")));
}

TEST_F(DialogAlone, OpensAfterTheFilesThatWereNamedAreLoaded)
{
    const std::string file = copySample("primes.zmb");
    openAlone({"--modrig", file});
    press("Escape");
    EXPECT_THAT(mHost->waitForEnd(), Optional(0));
    EXPECT_EQ(mHost->output(), "Primes: type PRIMES to see them on a spiral.\n" + file + " is loaded.\n");
}
