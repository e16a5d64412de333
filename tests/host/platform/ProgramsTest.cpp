#include "host/platform/Programs.h"

#include <gtest/gtest.h>

#include <csignal>
#include <sstream>
#include <string>

#include <fcntl.h>
#include <sys/wait.h>
#include <unistd.h>

#include "host/platform/Descriptor.h"
#include "tests/support/TemporaryFolder.h"

using tessel::outputOfProgram;
using tessel::showByProgram;

namespace
{
struct Process
{
    pid_t number = 0;
    pid_t session = 0;
};

Process processIn(const std::string& stat)
{
    std::istringstream facts(stat);
    Process process;
    std::string between; // name, state, parent and group
    facts >> process.number >> between >> between >> between >> between >> process.session;
    EXPECT_TRUE(facts) << stat;
    return process;
}
} // namespace

TEST(Programs, GetTheirArgumentsAsTheyAre)
{
    EXPECT_EQ(outputOfProgram({"printf", "%s|", "$HOME", "a  b", "'\"`;*", ""}), "$HOME|a  b|'\"`;*||");
}

TEST(Programs, AreReadToTheirEnd)
{
    EXPECT_EQ(outputOfProgram({"head", "-c", "300000", "/dev/zero"}), std::string(300'000, '\0'));
}

TEST(Programs, AreWaitedForAndPutAway)
{
    outputOfProgram({"true"});
    EXPECT_EQ(waitpid(-1, nullptr, WNOHANG), -1);
}

TEST(Programs, HaveNothingToReadAndComplainToNobody)
{
    const TemporaryFolder folder;
    const tessel::Descriptor before(dup(STDIN_FILENO));
    const tessel::Descriptor typed(open(folder.write("typed", "typed\n").c_str(), O_RDONLY));
    ASSERT_EQ(dup2(typed.number(), STDIN_FILENO), STDIN_FILENO);
    testing::internal::CaptureStderr();
    EXPECT_EQ(outputOfProgram({"cat", "-", "/nowhere/at/all"}), "");
    EXPECT_EQ(testing::internal::GetCapturedStderr(), "");
    dup2(before.number(), STDIN_FILENO);
}

TEST(Programs, RunInASessionOfTheirOwn)
{
    const Process process = processIn(outputOfProgram({"cat", "/proc/self/stat"}));
    EXPECT_EQ(process.session, process.number);
}

TEST(Programs, ThatAreNotThereWriteNothing)
{
    EXPECT_EQ(outputOfProgram({"no-such-program-anywhere"}), "");
    EXPECT_FALSE(tessel::startProgram({"no-such-program-anywhere"}));
}

// A browser, and all that it starts in its turn, expects to be ended by a pipe that nobody reads.
TEST(Programs, AreEndedByTheSignalsThatTheHostDoesWithout)
{
    for (const int signal : {SIGPIPE, SIGXFSZ})
    {
        const auto before = std::signal(signal, SIG_IGN);
        const std::string kill = "kill -s " + std::to_string(signal) + " $$; echo goes on";
        EXPECT_EQ(outputOfProgram({"sh", "-c", kill}), "") << signal;
        EXPECT_EQ(WTERMSIG(showByProgram({"sh", "-c", kill}, "").value_or(0)), signal);
        std::signal(signal, before);
    }
}

// Who starts Tessel so that it outlives the terminal means what it starts, too.
TEST(Programs, IgnoreWhatSomebodyElseWantsIgnored)
{
    const auto before = std::signal(SIGHUP, SIG_IGN);
    EXPECT_EQ(outputOfProgram({"sh", "-c", "kill -s HUP $$; echo goes on"}), "goes on\n");
    std::signal(SIGHUP, before);
}

TEST(Programs, ThatShowATextReadItAndWriteWhereWeDo)
{
    testing::internal::CaptureStdout();
    const auto status = showByProgram({"sed", "s/^/shown: /"}, "a text\n");
    EXPECT_EQ(testing::internal::GetCapturedStdout(), "shown: a text\n");
    EXPECT_EQ(status, 0);
}

TEST(Programs, ThatShowATextStayAtOurTerminal)
{
    testing::internal::CaptureStdout();
    showByProgram({"cat", "/proc/self/stat"}, "");
    EXPECT_EQ(processIn(testing::internal::GetCapturedStdout()).session, getsid(0));
}

TEST(Programs, ThatShowATextEndAsTheyDo)
{
    EXPECT_EQ(WEXITSTATUS(showByProgram({"sh", "-c", "exit 3"}, "").value_or(0)), 3);
    EXPECT_EQ(showByProgram({"no-such-program-anywhere"}, ""), std::nullopt);
}

TEST(Programs, ThatShowATextEndByASignalThatWeIgnore)
{
    const auto before = std::signal(SIGINT, SIG_IGN);
    EXPECT_EQ(WTERMSIG(showByProgram({"sh", "-c", "kill -INT $$; exit 3"}, "").value_or(0)), SIGINT);
    std::signal(SIGINT, before);
}
