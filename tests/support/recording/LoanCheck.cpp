// Every program on the recording host gets this check: whatever a test did, its end finds everything given
// back. It looks after the fixture's own end.
#include <gmock/gmock.h>

#include "tests/support/recording/RecordingLoans.h"

namespace
{
class LoanCheck : public testing::EmptyTestEventListener
{
    void OnTestEnd(const testing::TestInfo&) override
    {
        EXPECT_THAT(recording_loans::outstanding(), testing::IsEmpty()) << "not given back to the host";
        recording_loans::forgetAll(); // the next test has its own
    }
};

[[maybe_unused]] const bool isInstalled = []
{
    testing::UnitTest::GetInstance()->listeners().Append(new LoanCheck); // GoogleTest owns it
    return true;
}();
} // namespace
