// Tessel started from the Finder: the host's code for macOS, with a program in the place of the one that
// opens things there.
#include <gmock/gmock.h>

#include <cstdlib>
#include <fstream>
#include <iterator>

#include <sys/stat.h>

#include "host/app/TerminalWindow.h"
#include "host/app/platform/Terminal.h"
#include "tests/support/EnvironmentVariable.h"
#include "tests/support/ShellProgram.h"

TEST(Finder, GetsAWindowOfTerminalWithTesselInIt)
{
    const TemporaryFolder folder;
    const auto note = folder / "note";
    mkfifo(note.c_str(), 0600);
    writeProgram(folder, "open", "printf '%s\\n' \"$@\" >'" + note.string() + "'");
    const EnvironmentVariable path("PATH", folder.path().string() + ":" + std::getenv("PATH"));
    const tessel::ProgramStart byFinder = {1, 1, false, false};
    const auto program = "/Applications/My Tessel.app/Contents/MacOS/Tessel";
    ASSERT_TRUE(tessel::goesOnInTerminal(byFinder, tessel::programInTerminal(program)));
    std::ifstream words(note);
    EXPECT_EQ(std::string(std::istreambuf_iterator<char>(words), {}),
              "-b\ncom.apple.Terminal\n/Applications/My Tessel.app/Contents/MacOS/Tessel\n");
}
