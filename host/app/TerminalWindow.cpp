#include "host/app/TerminalWindow.h"

#include <sys/stat.h>
#include <unistd.h>

namespace tessel
{
namespace
{
constexpr pid_t kFirstProcess = 1;

bool isEmptyFile(int descriptor)
{
    struct stat input = {};
    struct stat empty = {};
    return fstat(descriptor, &input) == 0 && stat("/dev/null", &empty) == 0 && S_ISCHR(input.st_mode) &&
           input.st_rdev == empty.st_rdev;
}

// Its first program is the parent, and there is nothing to read or to show to.
bool isByDesktop(const ProgramStart& start)
{
    return start.words == 1 && start.parent == kFirstProcess && !start.hasInput && !start.hasScreen;
}
} // namespace

ProgramStart startOfProgram(int words)
{
    return {words, getppid(), !isEmptyFile(STDIN_FILENO), isatty(STDOUT_FILENO) != 0};
}

bool goesOnInTerminal(const ProgramStart& start, const ProgramWords& words)
{
    return !words.empty() && isByDesktop(start) && startProgram(words);
}
} // namespace tessel
