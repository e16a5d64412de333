// A start by a desktop, which leads to a window of the terminal.
#include <gtest/gtest.h>

#include <fstream>
#include <iterator>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include "host/app/TerminalWindow.h"
#include "tests/support/ShellProgram.h"

using tessel::goesOnInTerminal;
using tessel::ProgramStart;
using tessel::ProgramWords;
using tessel::startOfProgram;

namespace
{
constexpr ProgramStart kByDesktop = {1, 1, false, false};

// What opens the window: it tells what it was given, to somebody who waits for it.
class TerminalWindow : public testing::Test
{
protected:
    TerminalWindow() { mkfifo(mNote.c_str(), 0600); }

    ProgramWords words() const
    {
        const auto opener = writeProgram(mFolder, "open", "printf '%s' \"$*\" >'" + mNote.string() + "'");
        return {opener.string(), "/Applications/Tessel"};
    }
    std::string opened() const
    {
        std::ifstream note(mNote);
        return {std::istreambuf_iterator<char>(note), {}};
    }

    TemporaryFolder mFolder;

private:
    std::filesystem::path mNote = mFolder / "note";
};

// The standard input as another file, as long as this lasts.
class OtherInput
{
public:
    explicit OtherInput(const char* file) : mBefore(dup(STDIN_FILENO))
    {
        const int other = open(file, O_RDONLY);
        dup2(other, STDIN_FILENO);
        ::close(other);
    }
    ~OtherInput()
    {
        dup2(mBefore, STDIN_FILENO);
        ::close(mBefore);
    }
    OtherInput(const OtherInput&) = delete;
    OtherInput& operator=(const OtherInput&) = delete;

private:
    int mBefore;
};
} // namespace

TEST_F(TerminalWindow, OpensForADesktop)
{
    ASSERT_TRUE(goesOnInTerminal(kByDesktop, words()));
    EXPECT_EQ(opened(), "/Applications/Tessel");
}

TEST_F(TerminalWindow, StaysAwayWhereAnythingTellsOfAnotherStart)
{
    EXPECT_FALSE(goesOnInTerminal({2, 1, false, false}, words()));
    EXPECT_FALSE(goesOnInTerminal({1, 2, false, false}, words()));
    EXPECT_FALSE(goesOnInTerminal({1, 1, true, false}, words()));
    EXPECT_FALSE(goesOnInTerminal({1, 1, false, true}, words()));
}

TEST_F(TerminalWindow, IsNoneWhereNothingOpensOne)
{
    EXPECT_FALSE(goesOnInTerminal(kByDesktop, {}));
    EXPECT_FALSE(goesOnInTerminal(kByDesktop, {"/no/such/program"}));
}

TEST_F(TerminalWindow, GoesByWhatTheProgramFinds)
{
    const OtherInput nothing("/dev/null");
    const ProgramStart start = startOfProgram(3);
    EXPECT_EQ(start.words, 3);
    EXPECT_EQ(start.parent, getppid());
    EXPECT_FALSE(start.hasInput);
    EXPECT_EQ(start.hasScreen, isatty(STDOUT_FILENO) == 1);
}

TEST_F(TerminalWindow, CountsEveryOtherFileAsInput)
{
    const OtherInput file(mFolder.write("script", "QUIT").c_str());
    EXPECT_TRUE(startOfProgram(1).hasInput);
}

TEST_F(TerminalWindow, CountsAnotherDeviceAsInput)
{
    const OtherInput zeros("/dev/zero");
    EXPECT_TRUE(startOfProgram(1).hasInput);
}
