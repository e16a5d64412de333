// Ctrl-C, and the wish of the system that the program ends, once windows have been there.
#include <csignal>

#include "tests/e2e/HostTerminal.h"
#include "tests/e2e_dialogs/DialogTest.h"
#include "tests/support/Content.h"

namespace
{
class DialogSignals : public DialogTest
{
protected:
    // Loads a file, so that there is something to store; answers its path.
    std::string loadOne()
    {
        const std::string path = writeLisp("a.lsp");
        setSetting("SaveHistory", "1");
        open();
        loadFile(0, "a.lsp");
        return path;
    }

    void expectGoodEnd(int signal, const std::string& path)
    {
        mHost->signal(signal);
        EXPECT_EQ(mHost->waitForEnd(), 128 + signal) << mHost->output();
        EXPECT_EQ(stored("History"), "NumHistory = 1\n1History = " + path + "\n");
        EXPECT_EQ(storedSetting("SaveHistory"), "1\n");
    }
};
} // namespace

TEST_F(DialogSignals, EndAHostWithItsDialogOpen)
{
    for (const int signal : {SIGTERM, SIGHUP})
        expectGoodEnd(signal, loadOne());
}

// The dialog is a command of Modrig's; while it waits for a person, nothing of Modrig's is to blame.
TEST_F(DialogSignals, BlameNobodyWhenTheDialogWaited)
{
    for (const int signal : {SIGKILL, SIGTERM, SIGHUP})
    {
        open();
        mHost->signal(signal);
        ASSERT_TRUE(mHost->waitForEnd()) << signal;
        const std::string next = mSession.run({"APPS"}).output;
        EXPECT_THAT(next, testing::HasSubstr("Modrig.bundle")) << signal;
        EXPECT_THAT(next, testing::Not(testing::HasSubstr("ended Tessel"))) << signal;
    }
}

TEST_F(DialogSignals, BlameModrigWhenItsDialogFaults)
{
    open();
    mHost->signal(SIGSEGV);
    EXPECT_EQ(mHost->waitForEnd(), -SIGSEGV);
    EXPECT_THAT(mHost->output(), testing::HasSubstr("has ended Tessel while its command \"MODRIG\" ran: "));
    EXPECT_THAT(mSession.run({"APPS"}).output, testing::HasSubstr("Modrig.bundle\" ended Tessel "));
}

TEST_F(DialogSignals, EndAHostWithWindowsOverItsDialog)
{
    const std::string path = loadOne();
    openSuite();
    mScreen.click(mSuite, places::kAdd);
    ASSERT_FALSE(mScreen.waitForWindow(kAddPanel).empty());
    expectGoodEnd(SIGTERM, path);
}

TEST_F(DialogSignals, EndAHostWithAMessageBoxOverItsDialog)
{
    writeBroken();
    const std::string path = loadOne();
    loadBroken(1);
    expectGoodEnd(SIGTERM, path);
}

TEST_F(DialogSignals, EndAHostThatShowsAListOfFileTypes)
{
    const std::string path = loadOne();
    mScreen.press(mDialog, places::kFileTypes);
    shoot("choosing");
    expectGoodEnd(SIGTERM, path);
}

TEST_F(DialogSignals, EndAHostThatReadsFromAPipeAfterItsDialog)
{
    open();
    mScreen.key("Escape");
    EXPECT_TRUE(mScreen.waitUntilGone(kDialog));
    mHost->signal(SIGTERM);
    EXPECT_EQ(mHost->waitForEnd(), 128 + SIGTERM) << mHost->output();
}

TEST_F(DialogSignals, LetAHostReadOnFromAPipeAfterCtrlC)
{
    open();
    mScreen.key("Escape");
    EXPECT_TRUE(mScreen.waitUntilGone(kDialog));
    mHost->signal(SIGINT);
    mHost->type("(+ 30 12)");
    EXPECT_TRUE(prints("\n42\n"));
    mHost->signal(SIGINT);
    EXPECT_THAT(end(), testing::HasSubstr("Command: QUIT"));
}

TEST_F(DialogSignals, StopLispAndClearTheLineAfterADialogToo)
{
    HostTerminal terminal(mSession);
    ASSERT_TRUE(terminal.awaitPrompt());
    terminal.type("MODRIG\r");
    mDialog = mScreen.waitForActive(kDialog);
    ASSERT_FALSE(mDialog.empty()) << terminal.screen();
    mScreen.key("Escape");
    ASSERT_TRUE(terminal.awaitPrompt());
    ASSERT_TRUE(controlCStopsLisp(terminal));
    ASSERT_TRUE(controlCClearsTheLine(terminal));
    terminal.type("(+ 30 12)\r");
    EXPECT_TRUE(terminal.shows("\n42")) << terminal.screen();
    kill(terminal.process(), SIGTERM);
    EXPECT_EQ(terminal.waitForEnd(), 128 + SIGTERM);
}

TEST_F(DialogSignals, KeepWhatWasTypedWithTheDialogOpen)
{
    for (const int signal : {SIGTERM, SIGHUP})
    {
        HostTerminal terminal(mSession);
        ASSERT_TRUE(terminal.shows("Command: ")) << terminal.screen();
        terminal.type("REGISTRY SET Software\\Mine name " + std::to_string(signal) + "\r");
        ASSERT_TRUE(terminal.shows("Command: ")) << terminal.screen();
        terminal.type("MODRIG\r");
        ASSERT_FALSE(mScreen.waitForWindow(kDialog).empty()) << terminal.screen();
        kill(terminal.process(), signal);
        EXPECT_EQ(terminal.waitForEnd(), 128 + signal) << terminal.screen();
        const std::string kept = contentOf(mSession.profile() / "history");
        EXPECT_TRUE(kept.ends_with("name\\040" + std::to_string(signal) + "\nMODRIG\n")) << kept;
        EXPECT_THAT(mSession.run({"REGISTRY GET Software\\Mine name"}).output,
                    testing::EndsWith("\n" + std::to_string(signal) + "\n"));
    }
}

// At a terminal a message box is a window, and may be the first one.
TEST_F(DialogSignals, EndAHostAfterAMessageBoxOfItsStart)
{
    storeSuite({writeBroken()});
    HostTerminal terminal(mSession);
    ASSERT_FALSE(mScreen.waitForActive(kMessageBox).empty()) << terminal.screen();
    mScreen.key("Return");
    ASSERT_TRUE(terminal.awaitPrompt());
    ASSERT_TRUE(controlCStopsLisp(terminal));
    kill(terminal.process(), SIGTERM);
    EXPECT_EQ(terminal.waitForEnd(), 128 + SIGTERM);
}

TEST_F(DialogSignals, EndAHostThatShowsAMessageBoxOfItsStart)
{
    storeSuite({writeBroken(), writeBroken("second.zmb")});
    HostTerminal terminal(mSession);
    ASSERT_FALSE(mScreen.waitForWindow(kMessageBox).empty()) << terminal.screen();
    kill(terminal.process(), SIGTERM);
    EXPECT_EQ(terminal.waitForEnd(), 128 + SIGTERM);
}
