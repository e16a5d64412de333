// When Lisp is interrupted, with a thread in the place of Lisp.
#include "host/lisp/LispInterrupter.h"

#include <gtest/gtest.h>

using tessel::LispInterrupter;

namespace
{
class InterruptedThread : public testing::Test
{
protected:
    void waitForInterrupt() { mSent.wait(0); }
    void send()
    {
        ++mSent;
        mSent.notify_all();
    }

    std::atomic<int> mSent = 0;
    std::atomic<int> mBegun = 0;
    std::atomic<int> mEnded = 0;

    LispInterrupter::Ways ways()
    {
        return {.begin = [this] { ++mBegun; },
                .send = [this] { send(); },
                .end =
                    [this]
                {
                    ++mEnded;
                }};
    }
};

// Somebody who leans on the key.
class Leaning
{
public:
    explicit Leaning(LispInterrupter& interrupter)
        : mThread(
              [this, &interrupter]
              {
                  while (!mOver)
                      interrupter.interrupt();
              })
    {
    }
    ~Leaning()
    {
        mOver = true;
        mThread.join();
    }
    Leaning(const Leaning&) = delete;
    Leaning& operator=(const Leaning&) = delete;

private:
    std::atomic<bool> mOver = false;
    std::thread mThread;
};
} // namespace

TEST_F(InterruptedThread, IsSentOneInterruptAndTakesItOnce)
{
    const auto started = LispInterrupter::start(ways());
    ASSERT_TRUE(started);
    LispInterrupter& interrupter = **started;
    interrupter.begin();
    std::thread([&] { interrupter.interrupt(); }).join();
    waitForInterrupt();
    EXPECT_FALSE(interrupter.hasTakenRequest());
    EXPECT_TRUE(interrupter.takeRequest());
    EXPECT_FALSE(interrupter.takeRequest());
    EXPECT_TRUE(interrupter.hasTakenRequest());
    interrupter.end();
    EXPECT_FALSE(interrupter.hasTakenRequest());
    EXPECT_EQ(mSent, 1);
}

TEST_F(InterruptedThread, IsSentOneAfterAnotherUntilItEndsWhenItIsToEnd)
{
    auto insisting = ways();
    insisting.timeToCleanUp = std::chrono::milliseconds(250);
    const auto started = LispInterrupter::start(insisting);
    ASSERT_TRUE(started);
    LispInterrupter& interrupter = **started;
    interrupter.begin();
    interrupter.interruptUntilItEnds();
    for (int sent = 0; sent < 3; ++sent)
    {
        mSent.wait(sent);
        EXPECT_TRUE(interrupter.takeRequest());
    }
    interrupter.end();
    const int sent = mSent;
    interrupter.begin(); // something else, which nobody has asked to end
    std::this_thread::sleep_for(2 * insisting.timeToCleanUp);
    interrupter.end();
    EXPECT_EQ(mSent, sent);
}

TEST_F(InterruptedThread, IsLeftAloneWhileNothingRuns)
{
    {
        const auto started = LispInterrupter::start(ways());
        ASSERT_TRUE(started);
        LispInterrupter& interrupter = **started;
        interrupter.begin();
        interrupter.end();
        interrupter.interrupt();
    }
    EXPECT_EQ(mSent, 0);
    EXPECT_EQ(mBegun, 1);
    EXPECT_EQ(mEnded, 1);
}

// Whoever leaves what he was doing must not be called again on the way.
TEST_F(InterruptedThread, IsNotSentAnotherInterruptWhileItTakesTheFirst)
{
    using namespace std::chrono_literals;
    using Clock = std::chrono::steady_clock;
    for (int round = 0; round < 300; ++round)
    {
        mSent = 0;
        const auto started = LispInterrupter::start(ways());
        ASSERT_TRUE(started);
        LispInterrupter& interrupter = **started;
        const Leaning leaning(interrupter);
        interrupter.begin();
        waitForInterrupt();
        const auto taken = Clock::now();
        EXPECT_TRUE(interrupter.takeRequest());
        while (Clock::now() - taken < 20us)
            continue;
        const int sent = mSent;
        const bool soon = Clock::now() - taken < 100ms; // a busy machine may have kept us for longer
        EXPECT_TRUE(sent == 1 || !soon) << sent << " in round " << round;
        interrupter.end();
    }
}

// Nested evaluations are one to whoever interrupts.
TEST_F(InterruptedThread, TakesWhatIsMeantForWhatRunsAndNothingOnceThatIsOver)
{
    const auto started = LispInterrupter::start(ways());
    ASSERT_TRUE(started);
    LispInterrupter& interrupter = **started;
    const Leaning one(interrupter);
    const Leaning other(interrupter);
    for (int round = 0; round < 50; ++round)
    {
        const int before = mSent;
        EXPECT_FALSE(interrupter.running());
        interrupter.begin();
        interrupter.begin();
        mSent.wait(before);
        interrupter.end();
        EXPECT_TRUE(interrupter.running());
        EXPECT_TRUE(round % 2 == 0 || interrupter.takeRequest()) << "in round " << round;
        interrupter.end();
        EXPECT_FALSE(interrupter.takeRequest()) << "in round " << round;
    }
}
