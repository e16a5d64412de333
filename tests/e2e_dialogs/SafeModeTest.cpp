// The dialog in a session that loads nothing by itself.
#include "tests/e2e_dialogs/DialogTest.h"

using testing::HasSubstr;
using testing::Not;

class DialogSafeMode : public DialogTest
{
protected:
    DialogSafeMode() { mSession.alwaysWith({"--safe"}); }
};

TEST_F(DialogSafeMode, OpensAtOnceAndTakesAnEntryOutOfTheSuite)
{
    const std::string first = copySample("primes.zmb");
    const std::string second = copySample("gears.omp");
    const std::string third = writeLisp("third.lsp");
    storeSuite({first, second, third});
    open(); // no message box comes before it
    openSuite();
    mScreen.click(mSuite, places::kFirstSuiteRow);
    mScreen.click(mSuite, places::kRemove);
    mScreen.click(mSuite, places::kCloseSuite);
    EXPECT_TRUE(mScreen.waitUntilGone(kSuiteDialog));
    const std::string output = closeAndEnd();
    EXPECT_THAT(output, HasSubstr("Tessel was started with --safe and loads nothing by itself: APPS lists"));
    EXPECT_THAT(output, Not(HasSubstr("third.lsp runs")));
    EXPECT_EQ(stored("Startup"), "NumStartup = 2\n1Startup = " + second + "\n2Startup = " + third + "\n");
}

TEST_F(DialogSafeMode, LoadsWhatIsLoadedByHand)
{
    const std::string file = writeLisp("byhand.lsp");
    open();
    typeName("byhand.lsp");
    click(places::kLoad);
    EXPECT_TRUE(prints(wasLoaded("byhand.lsp")));
    EXPECT_THAT(closeAndEnd(), HasSubstr("byhand.lsp runs"));
}
