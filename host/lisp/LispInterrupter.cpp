#include "host/lisp/LispInterrupter.h"

#include <cerrno>
#include <csignal>
#include <system_error>
#include <utility>

#include <fcntl.h>
#include <poll.h>
#include <unistd.h>

#include "host/platform/SystemFailure.h"
#include "host/text/Translation.h"

namespace tessel
{
namespace
{
// Lisp that jumps out of what it was doing does not stand a second interrupt: the jump would arrive without
// its value.
constexpr auto kTimeToLeave = std::chrono::milliseconds(200);

// No signal of the program's is to land on the watcher: Ctrl-C has to wake the thread that waits for a line.
// Faults cannot be blocked, and the signals that stop threads for the garbage collector must not be.
void leaveSignalsToOthers()
{
    sigset_t signals;
    sigemptyset(&signals);
    for (const int signal :
         {SIGINT, SIGTERM, SIGHUP, SIGQUIT, SIGCHLD, SIGWINCH, SIGALRM, SIGPIPE, SIGTSTP, SIGCONT})
        sigaddset(&signals, signal);
    pthread_sigmask(SIG_BLOCK, &signals, nullptr);
}
} // namespace

Result<std::unique_ptr<LispInterrupter>> LispInterrupter::start(Ways ways)
try
{
    auto notes = openPipe();
    if (!notes)
        return Failure{translated(L"no pipe for interrupting Lisp: {}", notes.sentence())};
    return std::unique_ptr<LispInterrupter>(new LispInterrupter(std::move(ways), *std::move(notes)));
}
catch (const std::system_error& error) // the library's way to say that there is no thread
{
    return systemFailure(error.code().value());
}

LispInterrupter::LispInterrupter(Ways ways, Pipe notes) : mWays(std::move(ways)), mNotes(std::move(notes))
{
    // A signal handler must not wait, not even when somebody leans on Ctrl-C.
    fcntl(mNotes.input.number(), F_SETFL, O_NONBLOCK);
    mWatcher = std::thread(&LispInterrupter::watch, this);
}

LispInterrupter::~LispInterrupter()
{
    mNotes.input = Descriptor(-1);
    mWatcher.join();
}

void LispInterrupter::begin()
{
    if (mDepth++ > 0)
        return;
    const std::lock_guard lock(mRunChange);
    ++mRun;
}

void LispInterrupter::end()
{
    if (--mDepth > 0)
        return;
    const std::lock_guard lock(mRunChange);
    ++mRun;
}

void LispInterrupter::interrupt() noexcept
{
    const Run run = mRun.load();
    if (!isRun(run))
        return;
    const int error = errno;
    // A full pipe holds requests enough.
    [[maybe_unused]] const auto written = write(mNotes.input.number(), &run, sizeof run);
    errno = error;
}

void LispInterrupter::interruptUntilItEnds() noexcept
{
    mInsists = true;
    interrupt();
}

bool LispInterrupter::takeRequest() noexcept
{
    mTaken = std::chrono::steady_clock::now(); // before: without a request and without this the watcher would
                                               // send another
    if (mRequested.exchange(0) != mRun.load())
        return false;
    mTakenRun = mRun.load();
    return true;
}

std::optional<LispInterrupter::Run> LispInterrupter::receive() const
{
    Run run = 0;
    ssize_t count = 0;
    do
        count = read(mNotes.output.number(), &run, sizeof run);
    while (count < 0 && errno == EINTR);
    return count == sizeof run ? std::optional(run) : std::nullopt;
}

void LispInterrupter::watch()
{
    leaveSignalsToOthers();
    mWays.begin();
    while (const auto run = receive())
    {
        send(*run);
        while (mInsists && *run == mRun.load() && !isNoteThereWithin(mWays.timeToCleanUp))
            send(*run);
    }
    mWays.end();
}

// Or the end of the notes.
bool LispInterrupter::isNoteThereWithin(std::chrono::milliseconds time) const
{
    pollfd notes = {mNotes.output.number(), POLLIN, 0};
    return poll(&notes, 1, static_cast<int>(time.count())) > 0;
}

bool LispInterrupter::isOnItsWay(Run run) const
{
    return run == mSent &&
           (mRequested.load() == run || std::chrono::steady_clock::now() - mTaken.load() < kTimeToLeave);
}

void LispInterrupter::send(Run run)
{
    const std::lock_guard lock(mRunChange);
    if (run != mRun.load() || isOnItsWay(run))
        return;
    mSent = run;
    mRequested = run;
    mWays.send();
}
} // namespace tessel
