#include "modrig/dialogs/model/KeepingOut.h"

#include "tests/support/ModuleTest.h"
#include "tests/support/recording/RecordingKeptOut.h"

using namespace ModrigUtils;
using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
class KeepingOut : public ModuleTest
{
protected:
    void SetUp() override
    {
        ModuleTest::SetUp();
        host().services.set(TSRX_KEPT_OUT, &mService);
    }
    void TearDown() override
    {
        host().services.miss(TSRX_KEPT_OUT);
        ModuleTest::TearDown();
    }
    RecordingKeptOut mService;
    const std::vector<CStdStr> mBoth = {CStdStr(L"/a/one.zmb"), CStdStr(L"/a/two.lsp")};
};
} // namespace

TEST_F(KeepingOut, IsOfferedForWhatTheHostLoads)
{
    EXPECT_EQ(TableAction::kKeepOut, KeepingOutActionFor(mBoth));
}

TEST_F(KeepingOut, GivesWayToLettingInWhenOneOfThemIsKeptOut)
{
    mService.reasons[L"/a/two.lsp"] = L"It ended Tessel.";
    EXPECT_EQ(TableAction::kLetIn, KeepingOutActionFor(mBoth));
}

TEST_F(KeepingOut, IsNotOfferedByAHostThatCannot)
{
    host().services.miss(TSRX_KEPT_OUT);
    EXPECT_EQ(TableAction::kNone, KeepingOutActionFor(mBoth));
}

TEST_F(KeepingOut, TakesAllOfThem)
{
    mService.reasons[L"/a/one.zmb"] = L"It ended Tessel.";
    KeepAllOut(mBoth);
    EXPECT_THAT(mService.keptOut, ElementsAre(L"/a/one.zmb", L"/a/two.lsp"));
    EXPECT_THAT(mService.letInAgain, IsEmpty());
}

TEST_F(KeepingOut, EndsForThoseThatAreKeptOut)
{
    mService.reasons[L"/a/two.lsp"] = L"It ended Tessel.";
    LetAllIn(mBoth);
    EXPECT_THAT(mService.letInAgain, ElementsAre(L"/a/two.lsp"));
    EXPECT_THAT(mService.keptOut, IsEmpty());
}
