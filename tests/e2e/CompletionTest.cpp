// The Tab key after the name of a command.
#include <gmock/gmock.h>

#include "tests/e2e/HostTerminal.h"

namespace
{
class TabKey : public testing::Test
{
protected:
    void SetUp() override { ASSERT_TRUE(terminal.awaitPrompt()); }

    // What appears after the keys: of a line that is completed only what changes is drawn again.
    testing::AssertionResult shows(const std::string& keys, const std::string& text)
    {
        terminal.type(keys);
        return terminal.showsWithin(text, std::chrono::seconds(10))
                   ? testing::AssertionSuccess()
                   : testing::AssertionFailure() << terminal.screen();
    }

    HostSession session;
    std::filesystem::path lisp = session.folder().write("My Drawings/moon rise.lsp", "(princ \"risen\")\n");
    std::string folder = lisp.parent_path().parent_path().string();
    HostTerminal terminal{session, {"--safe"}};
};
} // namespace

TEST_F(TabKey, CompletesFilesAndFoldersInQuotesForTheirBlanks)
{
    EXPECT_TRUE(shows("load " + folder + "/My\tm\t\r", "risen"));
    EXPECT_TRUE(shows("", "/My Drawings/moon rise.lsp is loaded.\r\n"));
    EXPECT_TRUE(shows("CD " + folder + "/My\t\r", "/My Drawings\r\n"));
    EXPECT_TRUE(shows("load m\t\r", "risen"));
}

TEST_F(TabKey, CompletesWhatStandsInTheHomeFolder)
{
    std::filesystem::create_directories(session.folder() / "home/Lisp files");
    EXPECT_TRUE(shows("CD ~/L\t\r", "/home/Lisp files\r\n"));
}

TEST_F(TabKey, CompletesSubCommandsAndKeys)
{
    EXPECT_TRUE(shows("REGISTRY li\tsoft\tte\t\r", "\n[R21]\r\n"));
    EXPECT_TRUE(shows("bisect st\t\t", "START  STOP"));
}

TEST_F(TabKey, CompletesVariablesAndCommandsAsArguments)
{
    EXPECT_TRUE(shows("setvar LISPE\t\r", "\nLISPENABLED = 1\r\n"));
    EXPECT_TRUE(shows("HELP regis\t\r", "\nUsage: REGISTRY LIST [key]"));
}

TEST_F(TabKey, CompletesLispSymbolsAndFilesInStrings)
{
    EXPECT_TRUE(shows("(defun my-own-function () 42)\r", "MY-OWN-FUNCTION"));
    EXPECT_TRUE(shows("(my-o\t)\r", "\n42\r\n"));
    EXPECT_TRUE(shows("(progn\r", "... "));
    EXPECT_TRUE(shows("(load \"" + folder + "/My\tm\t))\r", "risen"));
    EXPECT_TRUE(shows("(string-up\t \"a\")\r", "\"A\""));
}
