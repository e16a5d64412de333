#include "modrig/dialogs/model/LoadProgress.h"

#include <gtest/gtest.h>

using ModrigUtils::LoadProgress;
using std::chrono::milliseconds;

namespace
{
class Progress : public testing::Test
{
protected:
    static LoadProgress::Time After(int time) { return LoadProgress::Time(milliseconds(5'000 + time)); }

    LoadProgress mProgress{After(0)};
};
} // namespace

TEST_F(Progress, IsNotToldBeforeASecondHasGone)
{
    EXPECT_FALSE(mProgress.IsTimeToTell(After(0)));
    EXPECT_FALSE(mProgress.IsTimeToTell(After(999)));
    EXPECT_TRUE(mProgress.IsTimeToTell(After(1'000)));
}

TEST_F(Progress, IsToldAFewTimesASecondFromThenOn)
{
    ASSERT_TRUE(mProgress.IsTimeToTell(After(1'500)));
    EXPECT_FALSE(mProgress.IsTimeToTell(After(1'699)));
    EXPECT_TRUE(mProgress.IsTimeToTell(After(1'700)));
}

TEST_F(Progress, LooksForTheKeyThatStopsItOnlyEveryNowAndThen)
{
    EXPECT_FALSE(mProgress.IsTimeToLook(After(49)));
    EXPECT_TRUE(mProgress.IsTimeToLook(After(50)));
    EXPECT_FALSE(mProgress.IsTimeToLook(After(99)));
    EXPECT_TRUE(mProgress.IsTimeToLook(After(100)));
}
