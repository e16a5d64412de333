// SUITE and HISTORY beside the dialog, which holds the lists that Modrig has read.
#include "tests/e2e_dialogs/DialogTest.h"

using testing::HasSubstr;

class DialogBesideListCommands : public DialogTest
{
protected:
    void close() const
    {
        press("Escape");
        EXPECT_TRUE(mScreen.waitUntilGone(kDialog));
    }

    void typeAndAwait(const std::string& command, const std::string& answer) const
    {
        mHost->type(command);
        EXPECT_TRUE(prints(answer)) << mHost->output();
    }
};

TEST_F(DialogBesideListCommands, ShowsTheHistoryThatACommandHasChangedAndStoresIt)
{
    const std::string first = writeLisp("a.lsp");
    const std::string second = writeLisp("b.lsp");
    openWithHistory({first});
    close();
    typeAndAwait("HISTORY ADD " + second, "b.lsp was added to the History list.\n");
    openAgain();
    mScreen.doubleClick(mDialog, places::tableRow(1));
    EXPECT_TRUE(prints(wasLoaded("b.lsp")));
    shoot("loaded");
    closeAndEnd();
    EXPECT_EQ(stored("History"), "NumHistory = 2\n1History = " + first + "\n2History = " + second + "\n");
}

TEST_F(DialogBesideListCommands, DoesNotUndoTheStartupSuiteThatACommandHasChanged)
{
    const std::string first = writeLisp("a.lsp");
    const std::string second = writeLisp("b.lsp");
    storeSuite({first});
    open();
    close();
    typeAndAwait("SUITE ADD " + second, "b.lsp was added to the Startup Suite.\n");
    typeAndAwait("SUITE MOVE " + second + " 1", "b.lsp is in place 1 of the Startup Suite now.\n");
    openAgain();
    EXPECT_THAT(closeAndEnd(), HasSubstr("b.lsp runs")) << "what the Suite has gained is loaded with Modrig";
    EXPECT_EQ(stored("Startup"), "NumStartup = 2\n1Startup = " + second + "\n2Startup = " + first + "\n");
}

TEST_F(DialogBesideListCommands, OfAnotherTesselKeepsThemFromChangingAnything)
{
    const std::string first = writeLisp("a.lsp");
    const std::string second = writeLisp("b.lsp");
    openWithHistory({first});
    const auto refused = mSession.start({"--safe", "-c", "HISTORY ADD " + second});
    EXPECT_EQ(refused.exitStatus, 1);
    EXPECT_THAT(refused.output, HasSubstr("the History list stays as it is. End the other Tessel first.\n"));
    closeAndEnd();
    EXPECT_EQ(stored("History"), "NumHistory = 1\n1History = " + first + "\n");
}
