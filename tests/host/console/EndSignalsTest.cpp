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
    bool isEnding() const override { return mEnding; }
    bool interrupt() noexcept override { return false; }
    void noteEndByKey() noexcept override {}
    void requestEnd() noexcept override { mEnding = true; }

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
} // namespace

TEST(EndSignals, ThatComeWhileTheHostEndsOnOneOfThemLetItEndInGoodOrder)
{
    EXPECT_EXIT(endTwice(true), testing::ExitedWithCode(kWentOn), "");
}

TEST(EndSignals, GoTheirDefaultWayAfterASessionThatNoneHasEnded)
{
    EXPECT_EXIT(endTwice(false), testing::KilledBySignal(SIGHUP), "");
}
