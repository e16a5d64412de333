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

TEST_F(DialogAlone, OpensAfterTheFilesThatWereNamedAreLoaded)
{
    const std::string file = copySample("primes.zmb");
    openAlone({"--modrig", file});
    press("Escape");
    EXPECT_THAT(mHost->waitForEnd(), Optional(0));
    EXPECT_EQ(mHost->output(), "Primes: type PRIMES to see them on a spiral.\n" + file + " is loaded.\n");
}
