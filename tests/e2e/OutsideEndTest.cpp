// Somebody ends the host from outside while no application is at work: the next start has nothing to ask.
#include <chrono>
#include <csignal>
#include <thread>

#include <gmock/gmock.h>

#include "tests/e2e/Applications.h"
#include "tests/e2e/HostTerminal.h"

namespace
{
class OutsideEnd : public testing::TestWithParam<int>
{
};
} // namespace

TEST_P(OutsideEnd, BlamesNobodyAtThePrompt)
{
    const HostSession session;
    storeSuite(session, {fixtureModule("Good.zmb"), lispFixture("good.lsp")});
    const std::string usual = session.run({"APPS"}).output;
    {
        HostTerminal terminal(session);
        ASSERT_TRUE(terminal.shows("Command: ")) << terminal.screen();
        terminal.type("LOAD " + fixtureModule("Command.zmb") + "\r");
        ASSERT_TRUE(terminal.shows("is loaded.")) << terminal.screen();
        terminal.type("PFAD\r");
        ASSERT_TRUE(terminal.shows("Command: ")) << terminal.screen();
        ASSERT_TRUE(terminal.shows("Command: ")) << terminal.screen();
        kill(terminal.process(), GetParam());
        terminal.waitForEnd();
    }
    EXPECT_EQ(session.run({"APPS"}).output, usual);
}

TEST(HungModule, IsEndedWithItsHostByASecondSignalSecondsLater)
{
    const HostSession session;
    HostTerminal terminal(session);
    ASSERT_TRUE(terminal.awaitPrompt());
    const std::string hangs = fixtureModule("Hangs.zmb");
    terminal.type("LOAD " + hangs + "\r");
    ASSERT_TRUE(terminal.awaitPrompt());
    terminal.type("HANG\r");
    ASSERT_TRUE(terminal.shows("hanging"));
    kill(terminal.process(), SIGTERM);
    kill(terminal.process(), SIGTERM); // no more hurry
    std::this_thread::sleep_for(std::chrono::milliseconds(2100));
    EXPECT_EQ(kill(terminal.process(), 0), 0) << "it waits for the module";
    kill(terminal.process(), SIGTERM);
    EXPECT_TRUE(terminal.shows("The application \"" + hangs +
                               "\" has ended Tessel while its command \"HANG\" ran: "
                               "it did not come back (SIGTERM)."))
        << terminal.screen();
    EXPECT_EQ(terminal.waitForEnd(), -SIGTERM);
}

INSTANTIATE_TEST_SUITE_P(By, OutsideEnd, testing::Values(SIGTERM, SIGHUP, SIGKILL),
                         [](const auto& signal) { return std::string(sigabbrev_np(signal.param)); });
