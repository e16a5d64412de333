// A registry that another program holds while Tessel starts: it is waited for, but not long and not in
// silence, and what can be read of it is read.
#include <gmock/gmock.h>

#include <chrono>
#include <csignal>
#include <thread>

#include "tests/e2e/Applications.h"
#include "tests/e2e/HostTerminal.h"
#include "tests/support/Database.h"

namespace fs = std::filesystem;

using std::chrono::seconds;
using testing::AllOf;
using testing::HasSubstr;
using testing::Not;

namespace
{
constexpr char kSuiteIsLoaded[] = "Good.zmb: message 1\ngood.lsp: loaded\n";
constexpr char kWhatHelps[] = " Close that program, or let it finish, and start Tessel again.\n";

class HeldRegistry : public testing::Test
{
protected:
    using Clock = std::chrono::steady_clock;

    // In the way of folders on a network, where who writes locks out who reads.
    HeldRegistry()
    {
        storeSuite(session, {fixtureModule("Good.zmb"), lispFixture("good.lsp")});
        useOldJournal(file());
    }

    fs::path file() const { return session.profile() / "registry.db"; }

    void hold(const char* by) { mHolder.hold(file(), by); }
    // What was changed is in the file by then, and what it was in the journal.
    void holdInTheMidstOfWriting()
    {
        hold("BEGIN EXCLUSIVE; UPDATE value SET data='half'");
        mHolder.writeOut();
    }
    void letGo() { mHolder.letGo(); }

    // How a session of one command went, which is to have waited that long for the registry.
    std::string outputAfterWaiting(seconds atLeast, seconds lessThan)
    {
        const auto begin = Clock::now();
        const auto result = session.run({"VERSION"});
        const auto taken = Clock::now() - begin;
        EXPECT_GE(taken, atLeast);
        EXPECT_LT(taken, lessThan);
        EXPECT_EQ(result.exitStatus, 0);
        EXPECT_THAT(result.output, AllOf(HasSubstr(kVersionLine), Not(HasSubstr("locked"))));
        return result.output;
    }

    std::string waits() const
    {
        return "Tessel waits for the registry " + file().string() +
               ", which another program holds. Ctrl-C goes on without it.\n";
    }

    HostSession session;

private:
    DatabaseHolder mHolder;
};
} // namespace

TEST_F(HeldRegistry, IsWaitedForOnceAndThenReadPastTheLock)
{
    hold("BEGIN EXCLUSIVE");
    EXPECT_THAT(outputAfterWaiting(seconds(5), seconds(8)),
                HasSubstr(waits() + "Nothing can be stored in the registry " + file().string() +
                          ": another program holds it. What is stored there is used." + kWhatHelps +
                          kSuiteIsLoaded));
}

TEST_F(HeldRegistry, IsReadAsItWasBeforeWhatIsBeingWritten)
{
    holdInTheMidstOfWriting();
    EXPECT_THAT(outputAfterWaiting(seconds(5), seconds(8)),
                HasSubstr(": another program holds it. What is stored there is used." +
                          std::string(kWhatHelps) + kSuiteIsLoaded));
    letGo();
    EXPECT_THAT(session.run({"VERSION"}).output, AllOf(HasSubstr(kSuiteIsLoaded), Not(HasSubstr("stored"))));
}

// So large that the change comes while it is copied, however busy the machine is.
TEST_F(HeldRegistry, IsNotReadWhileItChanges)
{
    hold("BEGIN EXCLUSIVE");
    session.set("LD_PRELOAD", FAULTY_CALLS);
    session.set("MODRIG_FAULT_TOUCH", "1");
    EXPECT_THAT(
        outputAfterWaiting(seconds(5), seconds(8)),
        AllOf(HasSubstr(waits() + "The registry " + file().string() +
                        " cannot be used: another program holds it. It was left as it is, and nothing "
                        "will be stored." +
                        kWhatHelps),
              Not(HasSubstr("loaded"))));
}

TEST_F(HeldRegistry, LeavesNoCopyBehind)
{
    fs::create_directory(session.folder() / "temporary");
    session.set("TMPDIR", (session.folder() / "temporary").string());
    hold("BEGIN EXCLUSIVE");
    outputAfterWaiting(seconds(5), seconds(8));
    for (const auto& entry : fs::directory_iterator(session.folder() / "temporary"))
        EXPECT_THAT(entry.path().filename().string(), Not(testing::StartsWith("tessel-")));
}

TEST_F(HeldRegistry, IsUsedAsEverOnceItIsLetGo)
{
    hold("BEGIN EXCLUSIVE");
    std::jthread soon(
        [this]
        {
            std::this_thread::sleep_for(seconds(3));
            letGo();
        });
    EXPECT_THAT(outputAfterWaiting(seconds(3), seconds(6)),
                AllOf(HasSubstr(waits() + kSuiteIsLoaded), Not(HasSubstr("stored"))));
}

TEST_F(HeldRegistry, IsNotSpokenOfWhenItIsLetGoSoon)
{
    hold("BEGIN EXCLUSIVE");
    std::jthread soon(
        [this]
        {
            std::this_thread::sleep_for(seconds(1));
            letGo();
        });
    EXPECT_THAT(outputAfterWaiting(seconds(1), seconds(4)), Not(HasSubstr("egistry")));
}

TEST_F(HeldRegistry, IsNotWaitedForAfterControlC)
{
    hold("BEGIN EXCLUSIVE");
    HostTerminal terminal(session);
    ASSERT_TRUE(terminal.shows("Ctrl-C goes on without it.")) << terminal.screen();
    const auto begin = Clock::now();
    terminal.type(kControlC);
    ASSERT_TRUE(terminal.shows("another program holds it. What is stored there is used."))
        << terminal.screen();
    ASSERT_TRUE(terminal.awaitPrompt());
    EXPECT_LT(Clock::now() - begin, seconds(2));
    EXPECT_EQ(terminal.quit(), 0);
}

TEST_F(HeldRegistry, IsNotWaitedForAfterTheWishToEnd)
{
    hold("BEGIN EXCLUSIVE");
    HostTerminal terminal(session);
    ASSERT_TRUE(terminal.shows("Ctrl-C goes on without it.")) << terminal.screen();
    const auto begin = Clock::now();
    ASSERT_EQ(kill(terminal.process(), SIGTERM), 0);
    EXPECT_EQ(terminal.waitForEnd(), 128 + SIGTERM);
    EXPECT_LT(Clock::now() - begin, seconds(2));
}

TEST_F(HeldRegistry, FailsACommandThatReadsAfterOneWait)
{
    session.set("LD_PRELOAD", FAULTY_CALLS);
    session.set("MODRIG_FAULT_NETWORK", "1"); // elsewhere readers are not locked out in a session
    HostTerminal terminal(session, {"--safe"});
    ASSERT_TRUE(terminal.awaitPrompt());
    hold("BEGIN EXCLUSIVE");
    const auto begin = Clock::now();
    terminal.type("REGISTRY LIST " + std::string(kSuiteKey) + "\r");
    EXPECT_TRUE(terminal.shows("Tessel waits for the registry " + file().string())) << terminal.screen();
    EXPECT_TRUE(terminal.shows("could not be read: another program holds it.")) << terminal.screen();
    ASSERT_TRUE(terminal.awaitPrompt());
    EXPECT_LT(Clock::now() - begin, seconds(8));
    EXPECT_EQ(terminal.quit(), 0);
}
