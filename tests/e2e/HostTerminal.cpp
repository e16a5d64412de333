#include "tests/e2e/HostTerminal.h"

#include <csignal>
#include <stdexcept>

#include <poll.h>
#include <pty.h>
#include <sys/ioctl.h>
#include <sys/wait.h>
#include <unistd.h>

#include "tests/support/ProgramArguments.h"

namespace
{
using Clock = std::chrono::steady_clock;

winsize windowOf(HostTerminal::Size size)
{
    return {size.rows, size.columns, 0, 0};
}
} // namespace

HostTerminal::HostTerminal(const HostSession& session, const std::vector<std::string>& arguments, Size size)
{
    const winsize window = windowOf(size);
    auto commandLine = session.commandLine(arguments);
    auto environment = session.environment();
    const auto argumentPointers = pointersTo(commandLine);
    const auto environmentPointers = pointersTo(environment);
    mProcess = forkpty(&mTerminal, nullptr, nullptr, &window);
    if (mProcess < 0)
        throw std::runtime_error("no terminal");
    if (mProcess == 0)
    {
        execve(argumentPointers.front(), argumentPointers.data(), environmentPointers.data());
        _exit(127);
    }
}

HostTerminal::~HostTerminal()
{
    if (mProcess > 0)
    {
        kill(mProcess, SIGKILL);
        waitpid(mProcess, nullptr, 0);
    }
    close(mTerminal);
}

void HostTerminal::type(std::string_view keys) const
{
    if (write(mTerminal, keys.data(), keys.size()) != static_cast<ssize_t>(keys.size()))
        throw std::runtime_error("the terminal takes no keys");
}

void HostTerminal::resize(Size size) const
{
    const winsize window = windowOf(size);
    if (ioctl(mTerminal, TIOCSWINSZ, &window) != 0)
        throw std::runtime_error("the terminal keeps its size");
}

bool HostTerminal::readMore(Clock::time_point deadline)
{
    const auto left = std::chrono::duration_cast<std::chrono::milliseconds>(deadline - Clock::now());
    pollfd ready{mTerminal, POLLIN, 0};
    if (left.count() <= 0 || poll(&ready, 1, static_cast<int>(left.count())) == 0)
        return false;
    char piece[4096];
    const ssize_t count = read(mTerminal, piece, sizeof piece);
    if (count <= 0)
        return false;
    mOutput.append(piece, static_cast<std::size_t>(count));
    return true;
}

bool HostTerminal::showsWithin(std::string_view text, std::chrono::milliseconds time)
{
    const auto deadline = Clock::now() + time;
    std::size_t place = mOutput.find(text, mSeen);
    while (place == mOutput.npos)
    {
        if (!readMore(deadline))
            return false;
        place = mOutput.find(text, mSeen);
    }
    mSeen = place + text.size();
    return true;
}

int HostTerminal::waitForEnd()
{
    const auto deadline = Clock::now() + kHostTimeLimit;
    while (readMore(deadline))
    {
    }
    if (Clock::now() >= deadline)
        kill(mProcess, SIGKILL);
    int status = 0;
    waitpid(mProcess, &status, 0);
    mProcess = 0;
    return WIFEXITED(status) ? WEXITSTATUS(status) : -WTERMSIG(status);
}

int HostTerminal::quit()
{
    type("QUIT\r");
    return waitForEnd();
}

namespace
{
// Types the keys, and Ctrl-C when the text has appeared.
testing::AssertionResult controlCAfter(HostTerminal& terminal, const std::string& keys,
                                       std::string_view appears)
{
    terminal.type(keys);
    if (!terminal.shows(appears))
        return testing::AssertionFailure() << terminal.screen();
    terminal.type(kControlC);
    return terminal.awaitPrompt();
}
} // namespace

testing::AssertionResult controlCStopsLisp(HostTerminal& terminal)
{
    return controlCAfter(terminal, kRunaway + "\r", "begun");
}

testing::AssertionResult controlCClearsTheLine(HostTerminal& terminal)
{
    return controlCAfter(terminal, "rubbish", "rubbish");
}
