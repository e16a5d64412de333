#include <gmock/gmock.h>
#include <tessel/tsresbuf.h>
#include <tessel/tsrx.h>

#include "tests/support/RecordingHost.h"

extern "C" int tsrxEntryPoint(unsigned message, void* application);

using testing::ElementsAre;

class Outside : public testing::Test
{
protected:
    void SetUp() override { recordingHost().reset(); }
};

TEST_F(Outside, SaysHello)
{
    ASSERT_EQ(tsrxEntryPoint(TSRX_MSG_LOAD, this), TSRX_RET_OK);
    EXPECT_TRUE(recordingHost().commands.type(L"outside"));
    EXPECT_THAT(recordingHost().output.lines(), ElementsAre(L"Hello from outside."));
}

TEST_F(Outside, FailsWhenSomethingIsNotGivenBack)
{
    static_cast<void>(tsutBuildList({TsRbValue::Short(1)}));
}
