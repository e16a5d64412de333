#include "tests/dialogs/support/VirtualDisplay.h"

#include <csignal>
#include <cstdlib>
#include <stdexcept>

#include <fcntl.h>
#include <sys/prctl.h>
#include <sys/wait.h>
#include <unistd.h>

namespace
{
// In the child: becomes the server, which writes the number of its display into the pipe.
[[noreturn]] void becomeServer(int numberPipe, DisplayKind kind)
{
    prctl(PR_SET_PDEATHSIG, SIGTERM); // a test that is killed leaves no server behind
    const int nothing = open("/dev/null", O_RDWR);
    dup2(nothing, STDOUT_FILENO);
    dup2(nothing, STDERR_FILENO);
    const std::string number = std::to_string(numberPipe);
    const std::string size = std::to_string(kind.width) + "x" + std::to_string(kind.height) + "x24";
    const std::string dotsPerInch = std::to_string(kind.dotsPerInch);
    execlp("Xvfb", "Xvfb", "-displayfd", number.c_str(), "-screen", "0", size.c_str(), "-dpi",
           dotsPerInch.c_str(), "-nolisten", "tcp", "-noreset", static_cast<char*>(nullptr));
    _exit(127);
}

// Up to the line's end; what was read when the server ends before.
std::string readLine(int descriptor)
{
    std::string line;
    for (char character = 0; read(descriptor, &character, 1) == 1 && character != '\n';)
        line += character;
    return line;
}
} // namespace

VirtualDisplay::VirtualDisplay(DisplayKind kind)
{
    int numberPipe[2];
    if (pipe(numberPipe) != 0)
        throw std::runtime_error("cannot make a pipe");
    mServer = fork();
    if (mServer == 0)
        becomeServer(numberPipe[1], kind);
    close(numberPipe[1]);
    const std::string number = readLine(numberPipe[0]);
    close(numberPipe[0]);
    if (number.empty())
        throw std::runtime_error("Xvfb does not start (Debian package xvfb)");
    mName = ":" + number;
}

VirtualDisplay::~VirtualDisplay()
{
    kill(mServer, SIGTERM);
    waitpid(mServer, nullptr, 0);
}
