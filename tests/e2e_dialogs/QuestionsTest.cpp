// What an application asks while a window is open: in a window over it.
#include <csignal>

#include "tests/e2e/HostTerminal.h"
#include "tests/e2e_dialogs/DialogTest.h"

using testing::HasSubstr;
using testing::Optional;

namespace
{
constexpr char kAsking[] = "AsksWhenLoaded.zmb"; // the title of what it asks, too
constexpr char kChoosePanel[] = "Choose a File";
constexpr Place kChooseFile{420, 70};
constexpr int kQuestionWidth = 484;

class DialogQuestions : public DialogTest
{
protected:
    explicit DialogQuestions(DisplayKind kind = {}) : DialogTest(kind)
    {
        std::filesystem::copy(std::filesystem::path(FIXTURE_MODULES) / kAsking, files() / kAsking);
        mSession.folder().write("files/drawing.txt", "");
    }

    std::string drawing() const { return (files() / "drawing.txt").string(); }

    // Loads what asks, and waits for its first question.
    void openQuestion()
    {
        open();
        pressLoad();
    }
    void pressLoad()
    {
        click(places::file(0));
        click(places::kLoad);
        mQuestion = mScreen.waitForActive(kAsking);
        ASSERT_FALSE(mQuestion.empty()) << mHost->output();
        shoot("text");
    }

    // Once the question that shows has gone.
    void awaitNext(const std::string& step)
    {
        mQuestion = mScreen.waitForAnotherWindow(kAsking, mQuestion);
        ASSERT_FALSE(mQuestion.empty()) << mHost->output();
        EXPECT_TRUE(mScreen.waitUntilActive(mQuestion));
        shoot(step);
    }

    void answer(const std::string& typed, const std::string& nextStep)
    {
        mScreen.text(typed);
        mScreen.key("Return");
        awaitNext(nextStep);
    }

    // Until the question has become higher or lower.
    bool changesItsSize(const std::string& before) const
    {
        return comesTrue([&] { return mScreen.sizeOf(mQuestion) != before; });
    }

    std::string mQuestion;
};
} // namespace

TEST_F(DialogQuestions, AreAnsweredByKeysInWindowsOverTheDialog)
{
    openQuestion();
    EXPECT_TRUE(mScreen.isOver(mQuestion, mDialog));
    answer("moon", "number");
    answer("", "yes-or-no");
    answer("", "file");
    mScreen.text(drawing());
    mScreen.key("Return");
    EXPECT_TRUE(
        prints("name moon, size 2.5, not kept, file " + drawing() + ", cancelled 0\n" + wasLoaded(kAsking)));
    EXPECT_TRUE(mScreen.waitUntilGone(kAsking));
    closeAndEnd();
}

TEST_F(DialogQuestions, ExplainWhatDoesNotFitAndKeepWhatWasTyped)
{
    openQuestion();
    answer("moon", "number");
    const std::string before = mScreen.sizeOf(mQuestion);
    mScreen.text("3x");
    mScreen.key("Return");
    EXPECT_TRUE(changesItsSize(before));
    shoot("no-number");
    mScreen.key("BackSpace");
    mScreen.key("Return");
    awaitNext("yes-or-no");
    mScreen.key("alt+y");
    awaitNext("file");
    const std::string low = mScreen.sizeOf(mQuestion);
    mScreen.text("/nowhere");
    mScreen.key("Return");
    EXPECT_TRUE(changesItsSize(low));
    shoot("no-file");
    mScreen.key("ctrl+a");
    mScreen.text(drawing());
    mScreen.key("Return");
    EXPECT_TRUE(prints("name moon, size 3, kept, file " + drawing() + ", cancelled 0\n"));
    closeAndEnd();
}

TEST_F(DialogQuestions, AreCancelledByEscapeTheCloseButtonItsKeyAndCtrlC)
{
    openQuestion();
    mScreen.key("Escape");
    awaitNext("number");
    mScreen.clickCloseButton(mQuestion, kQuestionWidth);
    awaitNext("yes-or-no");
    mScreen.key("alt+c");
    awaitNext("file");
    mHost->signal(SIGINT);
    EXPECT_TRUE(prints("name , size 0, not kept, file , cancelled 4\n" + wasLoaded(kAsking)));
    EXPECT_TRUE(mScreen.waitUntilGone(kAsking));
    shoot("cancelled");
    closeAndEnd();
}

TEST_F(DialogQuestions, AreCancelledByEveryPressOfCtrlC)
{
    openQuestion();
    for (const char* next : {"number", "yes-or-no", "file"})
    {
        mHost->signal(SIGINT);
        awaitNext(next);
    }
    mHost->signal(SIGINT);
    EXPECT_TRUE(prints("cancelled 4\n"));
    closeAndEnd();
}

TEST_F(DialogQuestions, GoWithTheSession)
{
    openQuestion();
    mHost->signal(SIGTERM);
    EXPECT_EQ(mHost->waitForEnd(), 128 + SIGTERM) << mHost->output();
    EXPECT_THAT(mHost->output(), HasSubstr("cancelled 4\n"));
}

TEST_F(DialogQuestions, HaveTheirFileChosenInAPanel)
{
    openQuestion();
    answer("moon", "number");
    answer("", "yes-or-no");
    answer("", "file");
    mScreen.text(files().string());
    mScreen.click(mQuestion, kChooseFile);
    const std::string panel = mScreen.waitForActive(kChoosePanel);
    ASSERT_FALSE(panel.empty());
    shoot("panel");
    mScreen.click(panel, places::file(1));
    mScreen.key("Return");
    EXPECT_TRUE(mScreen.waitUntilGone(kChoosePanel));
    EXPECT_TRUE(mScreen.waitUntilActive(mQuestion));
    shoot("chosen");
    mScreen.key("Return");
    EXPECT_TRUE(prints("file " + drawing() + ", cancelled 0\n"));
    closeAndEnd();
}

TEST_F(DialogQuestions, AreCancelledWithTheirPanel)
{
    openQuestion();
    mScreen.key("Escape");
    awaitNext("number");
    mScreen.key("Escape");
    awaitNext("yes-or-no");
    mScreen.key("Escape");
    awaitNext("file");
    mScreen.key("alt+h");
    ASSERT_FALSE(mScreen.waitForActive(kChoosePanel).empty());
    mHost->signal(SIGINT);
    EXPECT_TRUE(prints("cancelled 4\n"));
    EXPECT_TRUE(mScreen.waitUntilGone(kChoosePanel));
    closeAndEnd();
}

TEST_F(DialogQuestions, AreAskedBehindADialogThatStandsAlone)
{
    mHost = std::make_unique<Program>(mSession.commandLine({"--modrig"}), mSession.environment(),
                                      mSession.folder() / "output.txt");
    mDialog = mScreen.waitForActive(kDialog);
    ASSERT_FALSE(mDialog.empty()) << mHost->output();
    pressLoad();
    answer("moon", "number");
    answer("7", "yes-or-no");
    answer("", "file");
    mScreen.key("Escape");
    EXPECT_TRUE(prints("name moon, size 7, not kept, file , cancelled 1\n"));
    EXPECT_TRUE(mScreen.waitUntilActive(mDialog));
    mScreen.key("Escape");
    EXPECT_THAT(mHost->waitForEnd(), Optional(0));
}

TEST_F(DialogQuestions, AreAskedForAFileThatIsDropped)
{
    open();
    dragFiles({(files() / kAsking).string()}, places::tableRow(1),
              [this]
              {
                  mQuestion = mScreen.waitForActive(kAsking);
                  ASSERT_FALSE(mQuestion.empty()) << mHost->output();
                  answer("dropped", "number");
                  for (const char* next : {"yes-or-no", "file"})
                  {
                      mScreen.key("Escape");
                      awaitNext(next);
                  }
                  mScreen.key("Escape");
                  EXPECT_TRUE(prints("name dropped, size 0, not kept, file , cancelled 3\n"));
              });
    closeAndEnd();
}

// The terminal has a prompt of its own; the person is in front of the window.
TEST_F(DialogQuestions, AreAskedInTheWindowAlsoWhenThereIsATerminal)
{
    HostTerminal terminal(mSession);
    ASSERT_TRUE(terminal.awaitPrompt());
    terminal.type("MODRIG\r");
    mDialog = mScreen.waitForActive(kDialog);
    ASSERT_FALSE(mDialog.empty()) << terminal.screen();
    click(places::file(0));
    click(places::kLoad);
    mQuestion = mScreen.waitForActive(kAsking);
    ASSERT_FALSE(mQuestion.empty()) << terminal.screen();
    answer("moon", "number");
    terminal.type(kControlC);
    awaitNext("yes-or-no");
    mScreen.key("Return");
    awaitNext("file");
    terminal.type(kControlC);
    EXPECT_TRUE(terminal.shows("name moon, size 0, not kept, file , cancelled 2")) << terminal.screen();
    EXPECT_TRUE(mScreen.waitUntilActive(mDialog));
    mScreen.key("Escape");
    ASSERT_TRUE(terminal.awaitPrompt());
    terminal.type("ASKS\r");
    EXPECT_TRUE(terminal.shows("Name: ")) << "no window is open: " << terminal.screen();
    for (const char* next : {"Size <2.5>: ", "Keep it?", "File: ", "cancelled 4"})
    {
        terminal.type(kControlC);
        ASSERT_TRUE(terminal.shows(next)) << terminal.screen();
    }
    EXPECT_EQ(terminal.quit(), 0);
}

namespace
{
class DialogQuestionsOnALowScreen : public DialogQuestions
{
protected:
    DialogQuestionsOnALowScreen() : DialogQuestions({.width = 1200, .height = 900}) {}
};
} // namespace

// The screen is 800 by 600 points then.
TEST_F(DialogQuestionsOnALowScreen, AreAnsweredAtALargerScale)
{
    setToolkitSetting("GSScaleFactor", "1.5");
    open();
    mScreen.key("Down");
    mScreen.key("Return");
    mQuestion = mScreen.waitForActive(kAsking);
    ASSERT_FALSE(mQuestion.empty()) << mHost->output();
    answer("moon", "number");
    const std::string before = mScreen.sizeOf(mQuestion);
    mScreen.text("many");
    mScreen.key("Return");
    EXPECT_TRUE(changesItsSize(before));
    shoot("no-number");
    mScreen.key("ctrl+a");
    answer("4", "yes-or-no");
    answer("", "file");
    mScreen.text(drawing());
    mScreen.key("Return");
    EXPECT_TRUE(prints("name moon, size 4, not kept, file " + drawing() + ", cancelled 0\n"));
    closeAndEnd();
}
