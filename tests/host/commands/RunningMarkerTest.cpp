#include "host/commands/RunningMarker.h"

#include <csignal>
#include <optional>

#include <gtest/gtest.h>

#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>

#include "host/text/Unicode.h"
#include "tests/support/ChildProcess.h"
#include "tests/support/TemporaryFolder.h"

using tessel::RunningMarker;
using Deed = tessel::RunningMarker::Deed;
using Reason = tessel::RunningMarker::Reason;

namespace
{
class Marker : public testing::Test
{
protected:
    // Runs the work in a session of its own, which then ends without a word.
    template <class Work>
    void vanishAfter(Work work)
    {
        const pid_t child = fork();
        if (child == 0)
        {
            RunningMarker marker(mFolder.path());
            work(marker);
            kill(getpid(), SIGKILL);
        }
        int status = 0;
        waitpid(child, &status, 0);
        EXPECT_EQ(WTERMSIG(status), SIGKILL);
    }

    std::vector<RunningMarker::Leftover> leftovers() { return RunningMarker(mFolder.path()).leftovers(); }

    std::size_t filesOfSessions()
    {
        std::size_t count = 0;
        for (const auto& entry : std::filesystem::directory_iterator(mFolder.path()))
            count += entry.path().filename().native().starts_with("running.") ? 1 : 0;
        return count;
    }

    TemporaryFolder mFolder;
};
} // namespace

TEST_F(Marker, IsThereWhenTheProcessIsNot)
{
    const std::int64_t before = std::time(nullptr);
    vanishAfter(
        [](RunningMarker& marker)
        {
            const RunningMarker::ReasonScope reason(marker, Reason::kForAnother);
            marker.begin(Deed::kCommand, "/apps/Grüße.zmb", "HELLO");
        });
    const auto found = leftovers();
    ASSERT_EQ(found.size(), 1U);
    EXPECT_EQ(found[0].ending, RunningMarker::kVanished);
    EXPECT_EQ(found[0].work.deed, Deed::kCommand);
    EXPECT_EQ(found[0].work.reason, Reason::kForAnother);
    EXPECT_EQ(found[0].work.path, "/apps/Grüße.zmb");
    EXPECT_EQ(found[0].work.detail, "HELLO");
    EXPECT_FALSE(found[0].work.waitsForPerson);
    EXPECT_GE(found[0].work.since, before);
    EXPECT_LE(found[0].work.since, std::time(nullptr));
}

TEST_F(Marker, SaysNothingOfASessionInWhichNothingWasAtWork)
{
    vanishAfter([](RunningMarker& marker) { const RunningMarker::Scope over(marker, Deed::kLoading, "/a"); });
    EXPECT_TRUE(leftovers().empty());
}

TEST_F(Marker, NamesTheInnermost)
{
    vanishAfter(
        [](RunningMarker& marker)
        {
            marker.begin(Deed::kEntryPoint, "/outer");
            marker.begin(Deed::kLispFile, "/inner");
        });
    EXPECT_EQ(leftovers().at(0).work.path, "/inner");
}

TEST_F(Marker, NamesTheOuterAgainAfterTheInner)
{
    vanishAfter(
        [](RunningMarker& marker)
        {
            marker.begin(Deed::kCommand, "/outer", "OUT");
            const RunningMarker::Scope inner(marker, Deed::kLispFile, "/a/much/longer/inner");
            marker.endTo(1);
        });
    const auto found = leftovers();
    EXPECT_EQ(found.at(0).work.path, "/outer");
    EXPECT_EQ(found.at(0).work.detail, "OUT");
}

TEST_F(Marker, KeepsWhatASessionLeftUntilItIsForgotten)
{
    vanishAfter([](RunningMarker& marker) { marker.begin(Deed::kLoading, "/a"); });
    EXPECT_EQ(leftovers().size(), 1U);
    {
        RunningMarker marker(mFolder.path());
        EXPECT_EQ(marker.leftovers().size(), 1U);
        marker.forgetLeftovers();
    }
    EXPECT_TRUE(leftovers().empty());
    EXPECT_EQ(filesOfSessions(), 0U);
}

TEST_F(Marker, ReadsWhatSeveralSessionsLeft)
{
    for (const char* path : {"/a", "/b", "/c"})
        vanishAfter([path](RunningMarker& marker) { marker.begin(Deed::kLoading, path); });
    std::string paths;
    for (const auto& leftover : leftovers())
        paths += leftover.work.path;
    EXPECT_EQ(paths.size(), 6U);
    for (const char* path : {"/a", "/b", "/c"})
        EXPECT_NE(paths.find(path), std::string::npos) << paths;
}

TEST_F(Marker, DoesNotTakeARunningSessionForOneThatIsOver)
{
    const ChildProcess other(
        [this](int output)
        {
            RunningMarker marker(mFolder.path());
            marker.begin(Deed::kLoading, "/a");
            [[maybe_unused]] const auto told = write(output, "ready\n", 6);
            for (;;)
                pause();
        });
    ASSERT_EQ(other.readLine(), "ready");
    EXPECT_TRUE(leftovers().empty());
    EXPECT_EQ(filesOfSessions(), 1U) << "the other's is still there, and ours is gone";
}

TEST_F(Marker, KnowsWhetherAnotherSessionRuns)
{
    vanishAfter([](RunningMarker& marker) { marker.begin(Deed::kLoading, "/a"); });
    const RunningMarker own(mFolder.path());
    EXPECT_EQ(filesOfSessions(), 2U);
    EXPECT_FALSE(own.otherSessionRuns()) << "one that is over does not count, nor does this one";
    {
        const ChildProcess other(
            [this](int output)
            {
                const RunningMarker marker(mFolder.path());
                const std::string answer = marker.otherSessionRuns() ? "sees it\n" : "is alone\n";
                [[maybe_unused]] const auto told = write(output, answer.data(), answer.size());
                for (;;)
                    pause();
            });
        ASSERT_EQ(other.readLine(), "sees it");
        EXPECT_TRUE(own.otherSessionRuns());
        EXPECT_TRUE(own.otherSessionRuns()) << "asking changes nothing";
    }
    EXPECT_FALSE(own.otherSessionRuns());
    EXPECT_FALSE(RunningMarker().otherSessionRuns());
}

// An application may start programs of its own that outlive the host.
TEST_F(Marker, DoesNotTakeAChildOfTheSessionForTheSession)
{
    int ends[2];
    ASSERT_EQ(pipe(ends), 0);
    vanishAfter(
        [&](RunningMarker& marker)
        {
            marker.begin(Deed::kLoading, "/a");
            if (fork() != 0)
                return;
            char byte = 0;
            close(ends[1]);
            [[maybe_unused]] const auto over = read(ends[0], &byte, 1);
            _exit(0);
        });
    EXPECT_EQ(leftovers().size(), 1U);
    close(ends[0]);
    close(ends[1]);
}

TEST_F(Marker, TellsHowTheSessionEnded)
{
    vanishAfter(
        [](RunningMarker& marker)
        {
            marker.begin(Deed::kLoading, "/a");
            marker.noteEnding(SIGSEGV);
        });
    EXPECT_EQ(leftovers().at(0).ending, SIGSEGV);
}

// As when it faults on a thread that an application has started, while the host goes on.
TEST_F(Marker, StaysAsItWasWhenTheEndWasNoted)
{
    vanishAfter(
        [](RunningMarker& marker)
        {
            marker.begin(Deed::kEntryPoint, "/a");
            marker.noteEnding(SIGSEGV);
            marker.endTo(0);
        });
    EXPECT_EQ(leftovers().at(0).work.path, "/a");
    {
        RunningMarker(mFolder.path()).forgetLeftovers();
    }
    vanishAfter(
        [](RunningMarker& marker)
        {
            marker.begin(Deed::kEntryPoint, "/a");
            marker.noteEnding(SIGSEGV);
            marker.begin(Deed::kEntryPoint, "/b");
        });
    EXPECT_EQ(leftovers().at(0).work.path, "/a");
}

TEST_F(Marker, TellsThatACommandWaitedForAPersonAndNothingElseDoes)
{
    vanishAfter(
        [](RunningMarker& marker)
        {
            marker.begin(Deed::kCommand, "/a", "A");
            marker.noteWaiting();
        });
    EXPECT_TRUE(leftovers().at(0).work.waitsForPerson);
    {
        RunningMarker(mFolder.path()).forgetLeftovers();
    }
    vanishAfter(
        [](RunningMarker& marker)
        {
            marker.begin(Deed::kEntryPoint, "/a");
            marker.noteWaiting();
        });
    EXPECT_FALSE(leftovers().at(0).work.waitsForPerson);
}

TEST_F(Marker, CountsWhatIsDeeperThanItWritesDown)
{
    vanishAfter(
        [](RunningMarker& marker)
        {
            for (int depth = 0; depth < 1000; ++depth)
                marker.begin(Deed::kLispFile, "/" + std::to_string(depth));
            marker.endTo(2);
        });
    EXPECT_EQ(leftovers().at(0).work.path, "/1");
}

TEST_F(Marker, BlamesNobodyWherePathsDoNotFit)
{
    vanishAfter(
        [](RunningMarker& marker)
        {
            for (int depth = 0; depth < 100; ++depth)
                marker.begin(Deed::kLispFile, std::string(4000, 'x'));
        });
    EXPECT_EQ(leftovers().at(0).work.path, "");
}

TEST_F(Marker, PassesOverFilesThatAreNone)
{
    mFolder.write("running.1.0", "too short");
    mFolder.write("running.2.0", std::string(100000, '\xff'));
    std::filesystem::create_directory(mFolder / "running.3.0");
    EXPECT_TRUE(leftovers().empty());
}

TEST_F(Marker, MarksForAsLongAsTheProcessLastsWhereItsFolderCannotBeMade)
{
    const auto file = mFolder.write("file", "");
    RunningMarker marker(file / "folder");
    EXPECT_EQ(marker.outlivesProcess().sentence(), L"What ends Tessel cannot be remembered: the folder " +
                                                       (file / "folder").wstring() +
                                                       L" cannot be made: Not a directory.");
    const RunningMarker::Scope scope(marker, Deed::kLoading, "/a");
    RunningMarker::AtWork work{};
    ASSERT_TRUE(marker.innermost(work));
    EXPECT_EQ(work.path, "/a");
}

// The limit stands for a disk that becomes full in the midst of it.
TEST_F(Marker, NamesTheReasonWhereOnlyAPartOfItCanBeWritten)
{
    const std::string said = askChild(
        [this]
        {
            std::signal(SIGXFSZ, SIG_IGN);
            const rlimit limit = {4096, RLIM_INFINITY};
            setrlimit(RLIMIT_FSIZE, &limit);
            return tessel::toUtf8(RunningMarker(mFolder.path()).outlivesProcess().sentence());
        });
    EXPECT_NE(said.find(" cannot be written: File too large."), std::string::npos) << said;
}

TEST_F(Marker, OutlivesTheProcess)
{
    EXPECT_TRUE(RunningMarker(mFolder.path()).outlivesProcess());
}
