#include "host/platform/Programs.h"

#include <gtest/gtest.h>

#include <sstream>

#include <fcntl.h>
#include <sys/wait.h>
#include <unistd.h>

#include "host/platform/Descriptor.h"
#include "tests/support/TemporaryFolder.h"

using tessel::outputOfProgram;

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
    std::istringstream facts(outputOfProgram({"cat", "/proc/self/stat"}));
    std::string process;
    std::string word;
    std::string session;
    facts >> process >> word >> word >> word >> word >>
        session; // name, state, parent and group stand between
    EXPECT_FALSE(process.empty());
    EXPECT_EQ(session, process);
}

TEST(Programs, ThatAreNotThereWriteNothing)
{
    EXPECT_EQ(outputOfProgram({"no-such-program-anywhere"}), "");
    EXPECT_FALSE(tessel::startProgram({"no-such-program-anywhere"}));
}
