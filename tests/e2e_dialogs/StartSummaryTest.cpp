// A start in which things go wrong, in front of a person: at a terminal, with a display.
#include "tests/e2e/HostTerminal.h"
#include "tests/e2e_dialogs/DialogTest.h"

using testing::ContainsRegex;
using testing::HasSubstr;
using testing::Not;

namespace
{
class DialogStartSummary : public DialogTest
{
protected:
    std::string write(const std::string& name, const std::string& content) const
    {
        return mSession.folder().write("files/" + name, content).string();
    }

    // The only box of the start, in front; answered by Return.
    void answerTheBox(HostTerminal& terminal, const std::string& picture)
    {
        const std::string box = mScreen.waitForActive(kMessageBox);
        ASSERT_FALSE(box.empty()) << terminal.screen();
        mScreen.shoot(picture);
        EXPECT_THAT(terminal.screen(), Not(HasSubstr("Command: "))) << "the box comes before the prompt";
        mScreen.key("Return");
        EXPECT_TRUE(terminal.shows("Command: ")) << "another box is in the way: " << terminal.screen();
        EXPECT_EQ(mScreen.window(kMessageBox), "");
    }

    static void quit(HostTerminal& terminal) { EXPECT_EQ(terminal.quit(), 0) << terminal.screen(); }
};
} // namespace

TEST_F(DialogStartSummary, IsOneBoxForFiveBrokenEntriesOfTheSuite)
{
    write("empty.bundle/Resources/notes.txt", "no description");
    storeSuite({write("text.zmb", "Dear Sir or Madam,\n"), (files() / "missing.omp").string(),
                (files() / "empty.bundle").string(), write("never closed.lsp", "(car 5\n"),
                write("letter.txt", "Dear Sir or Madam,\n"), writeLisp("good.lsp")});
    HostTerminal terminal(mSession);
    answerTheBox(terminal, "DialogStartSummary-five");
    EXPECT_THAT(terminal.screen(), HasSubstr("good.lsp runs"));
    EXPECT_THAT(terminal.screen(), Not(HasSubstr("Message: ")));
    terminal.type("APPS\r");
    EXPECT_TRUE(terminal.shows("is not of a type that can be loaded."));
    for (const char* failed : {"text.zmb", "missing.omp", "empty.bundle", "never closed.lsp", "letter.txt"})
        EXPECT_THAT(terminal.screen(),
                    ContainsRegex("  " + std::string(failed) + " +" + files().string() + " "));
    quit(terminal);
}

TEST_F(DialogStartSummary, FitsOnASmallScreenHoweverManyAndLongTheReasons)
{
    std::vector<std::string> suite;
    const std::string longName(120, 'x');
    for (int number = 1; number <= 30; ++number)
        suite.push_back(
            write(longName + std::to_string(number) + ".lsp", "(error \"" + std::string(2000, 'y') + "\")"));
    storeSuite(suite);
    HostTerminal terminal(mSession);
    EXPECT_TRUE(
        terminal.shows(longName + "30.lsp: line 1: yyy")); // a terminal that nobody reads holds the host up
    const std::string box = mScreen.waitForWindow(kMessageBox);
    ASSERT_FALSE(box.empty()) << terminal.screen();
    const std::string size = mScreen.sizeOf(box);
    EXPECT_LE(std::stoi(size.substr(size.find('x') + 1)), 560) << size;
    EXPECT_THAT(terminal.screen(), HasSubstr("Message: 30 applications could not be loaded:"));
    answerTheBox(terminal, "DialogStartSummary-many");
    quit(terminal);
}

TEST_F(DialogStartSummary, IsNoBoxWhenAllWentWell)
{
    storeSuite({writeLisp("good.lsp")});
    HostTerminal terminal(mSession);
    EXPECT_TRUE(terminal.shows("Command: ")) << terminal.screen();
    EXPECT_EQ(mScreen.window(kMessageBox), "");
    quit(terminal);
}
