// The system may give a signal of the process to any of its threads: one of the network library's, say.
#include <atomic>
#include <csignal>
#include <thread>

#include <poll.h>

#include <gtest/gtest.h>

#include "host/console/EndSignals.h"
#include "host/console/InterruptKey.h"

namespace
{
class CountingRunner : public tessel::LineRunner
{
public:
    bool run(const std::wstring&) override { return true; }
    void lineBegins() override {}
    bool isLineInterrupted() const override { return false; }
    bool isEnding() const override { return mEnds > 0; }
    bool interrupt() noexcept override
    {
        ++mInterrupts;
        return false;
    }
    void noteEndByKey() noexcept override {}
    void requestEnd() noexcept override { ++mEnds; }
    bool runsLisp() const noexcept override { return false; }
    int interrupts() const { return mInterrupts; }
    int ends() const { return mEnds; }

private:
    std::atomic<int> mInterrupts = 0;
    std::atomic<int> mEnds = 0;
};

// What the end of one leaves ignored is taken again.
struct UsualActions
{
    ~UsualActions()
    {
        for (const int signal : {SIGTERM, SIGHUP})
            std::signal(signal, SIG_DFL);
    }
};
} // namespace

TEST(EndSignals, ThatAnotherThreadTakesAreReceived)
{
    const UsualActions usual;
    CountingRunner runner;
    const tessel::EndSignals signals(runner);
    std::thread other([] { std::raise(SIGTERM); });
    while (tessel::EndSignals::received() == 0)
        std::this_thread::yield();
    other.join();
    EXPECT_EQ(tessel::EndSignals::received(), SIGTERM);
    EXPECT_EQ(runner.ends(), 1);
}

TEST(EndSignals, ThatTwoThreadsTakeAtOnceAreToldByOneOfThem)
{
    for (int round = 0; round < 200; ++round)
    {
        const UsualActions usual;
        CountingRunner runner;
        const tessel::EndSignals signals(runner);
        std::thread one([] { std::raise(SIGTERM); });
        std::thread other([] { std::raise(SIGHUP); });
        while (tessel::EndSignals::received() == 0)
            std::this_thread::yield();
        const int first = tessel::EndSignals::received();
        one.join();
        other.join();
        EXPECT_EQ(tessel::EndSignals::received(), first);
        EXPECT_EQ(runner.ends(), 2);
    }
}

TEST(InterruptKey, ThatAnotherThreadTakesStopsTheRunnerAndWakesWhoWaits)
{
    CountingRunner runner;
    const tessel::InterruptKey key(runner);
    std::thread other([] { std::raise(SIGINT); });
    pollfd waiting = {key.wakeUp(), POLLIN, 0};
    EXPECT_EQ(poll(&waiting, 1, -1), 1);
    EXPECT_EQ(runner.interrupts(), 1);
    other.join();
}
