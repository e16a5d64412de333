// What fits on a person's screen.
#include <gmock/gmock.h>

#include <algorithm>
#include <clocale>
#include <cwchar>
#include <sstream>
#include <vector>

#include "tests/e2e/HostTerminal.h"

using testing::HasSubstr;

namespace
{
// As the system has it, which is not what the program asks.
std::size_t cellsOf(const std::string& text)
{
    std::setlocale(LC_CTYPE, "C.UTF-8");
    std::vector<wchar_t> wide(text.size() + 1);
    const std::size_t length = std::mbstowcs(wide.data(), text.c_str(), wide.size());
    return static_cast<std::size_t>(wcswidth(wide.data(), length));
}

// The widest line that appeared while the command ran.
std::size_t widestLine(HostTerminal& terminal, const std::string& command)
{
    const std::size_t before = terminal.screen().size();
    terminal.type(command + "\r");
    if (!terminal.shows("\n") || !terminal.awaitPrompt())
        return 0;
    std::istringstream lines(terminal.screen().substr(terminal.screen().find('\n', before) + 1));
    std::size_t widest = 0;
    for (std::string line; std::getline(lines, line);)
    {
        widest = std::max(widest, cellsOf(line.substr(0, line.find_first_of("\r\x1b"))));
    }
    return widest;
}
} // namespace

TEST(Width, OfWhatIsListedIsThatOfTheWindow)
{
    const HostSession session;
    HostTerminal terminal(session, {"--safe"}, {80, 60});
    ASSERT_TRUE(terminal.awaitPrompt());
    for (const char* command : {"HELP", "HELP LOAD", "HELP REGISTRY", "SETVAR", "APPS"})
    {
        const std::size_t widest = widestLine(terminal, command);
        EXPECT_GT(widest, 10u) << command;
        EXPECT_LE(widest, 80u) << command << terminal.screen();
    }
}

TEST(Width, FollowsTheWindow)
{
    const HostSession session;
    HostTerminal terminal(session, {"--safe"}, {120, 80});
    ASSERT_TRUE(terminal.awaitPrompt());
    const std::size_t wide = widestLine(terminal, "HELP");
    EXPECT_GT(wide, 60u);
    terminal.resize({40, 200});
    const std::size_t narrow = widestLine(terminal, "HELP");
    EXPECT_LE(narrow, 40u) << terminal.screen();
    EXPECT_GT(narrow, 30u) << terminal.screen();
    EXPECT_LE(widestLine(terminal, "SETVAR"), 40u) << terminal.screen();
}

TEST(Width, CountsAsManyCellsAsWideCharactersTake)
{
    const HostSession session;
    const auto folder = session.folder() / "図面の入っている長い名前のフォルダ";
    std::filesystem::create_directories(folder);
    const auto file = session.folder().write("図面の入っている長い名前のフォルダ/月.lsp", "1\n").string();
    HostTerminal terminal(session, {"--safe", file}, {50, 80});
    ASSERT_TRUE(terminal.awaitPrompt());
    const std::size_t widest = widestLine(terminal, "APPS");
    EXPECT_LE(widest, 50u) << terminal.screen();
    EXPECT_THAT(terminal.screen(), HasSubstr("\n  月.lsp\r\n      /"));
}

TEST(Width, IsNotLimitedForWhoReadsLineByLine)
{
    const HostSession session;
    const std::string name(100, 'n');
    const auto file = session.folder().write(name + ".lsp", "1\n").string();
    EXPECT_THAT(session.start({"--safe", file, "-c", "APPS"}).output,
                HasSubstr("\n  " + name + ".lsp " + session.folder().path().string() + " "));
}
