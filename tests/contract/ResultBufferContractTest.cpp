#include <tessel/tsresbuf.h>

#include "tests/contract/ContractTest.h"

using testing::ElementsAre;

namespace
{
using ResultBufferContract = ContractTest;

TEST_F(ResultBufferContract, BuildsAListInOrder)
{
    TsResultBuffer* list =
        tsutBuildList({TsRbValue::String(L"qz-load"), TsRbValue::Short(-3), TsRbValue::Long(70000),
                       TsRbValue::Real(0.5), TsRbValue::TrueValue(), TsRbValue::NilValue()});
    EXPECT_THAT(recordedValues(list),
                ElementsAre(RecordingValue::String(L"qz-load"), RecordingValue::Short(-3),
                            RecordingValue::Long(70000), RecordingValue::Real(0.5), RecordingValue::True(),
                            RecordingValue::Nil()));
    EXPECT_EQ(tsutRelRb(list), TS_NORMAL);
}

TEST_F(ResultBufferContract, CopiesStrings)
{
    std::wstring text = L"before";
    TsResultBuffer* list = tsutBuildList({TsRbValue::String(text.c_str())});
    text = L"after!";
    EXPECT_STREQ(list->value.string, L"before");
    tsutRelRb(list);
}

TEST_F(ResultBufferContract, BuildsNothingFromNothing)
{
    EXPECT_EQ(tsutBuildList({}), nullptr);
    EXPECT_EQ(tsutRelRb(nullptr), TS_NORMAL);
}
} // namespace
