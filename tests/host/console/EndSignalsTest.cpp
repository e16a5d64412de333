// The signals that end a session, and those that come when it is ending already.
#include "host/console/EndSignals.h"

#include <unistd.h>

#include <gtest/gtest.h>

using tessel::EndSignals;

namespace
{
constexpr int kWentOn = 7;

class EndingRunner : public tessel::LineRunner
{
public:
    bool run(const std::wstring&) override { return true; }
    void lineBegins() override {}
    bool isLineInterrupted() const override { return false; }
    bool isEnding() const override { return mEnding; }
    bool interrupt() noexcept override { return false; }
    void noteEndByKey() noexcept override {}
    void requestEnd() noexcept override { mEnding = true; }
    bool runsLisp() const noexcept override { return mRunsLisp; }

    bool mRunsLisp = false;

private:
    volatile bool mEnding = false;
};

// In a process of its own: what it does about a signal after the session.
[[noreturn]] void endTwice(bool signalBefore)
{
    EndingRunner runner;
    {
        const EndSignals signals(runner);
        if (signalBefore)
            raise(SIGTERM);
        if (runner.isEnding() != signalBefore)
            _exit(1);
    }
    raise(SIGHUP);
    _exit(kWentOn);
}

// Some seconds after the first: somebody has waited for the end in vain.
[[noreturn]] void askAgain(bool runsLisp)
{
    EndingRunner runner;
    runner.mRunsLisp = runsLisp;
    const EndSignals signals(runner);
    raise(SIGTERM);
    sleep(3);
    raise(SIGTERM);
    _exit(kWentOn);
}
} // namespace

TEST(EndSignals, ThatComeAgainEndAHostAtOnceWhoseLispDoesNotComeBack)
{
    EXPECT_EXIT(askAgain(true), testing::KilledBySignal(SIGTERM), "");
}

TEST(EndSignals, ThatComeAgainLetAHostStoreWhatItStores)
{
    EXPECT_EXIT(askAgain(false), testing::ExitedWithCode(kWentOn), "");
}

TEST(EndSignals, ThatComeWhileTheHostEndsOnOneOfThemLetItEndInGoodOrder)
{
    EXPECT_EXIT(endTwice(true), testing::ExitedWithCode(kWentOn), "");
}

TEST(EndSignals, GoTheirDefaultWayAfterASessionThatNoneHasEnded)
{
    EXPECT_EXIT(endTwice(false), testing::KilledBySignal(SIGHUP), "");
}
