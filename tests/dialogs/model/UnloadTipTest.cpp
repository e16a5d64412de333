#include "modrig/dialogs/model/UnloadTip.h"

#include <gmock/gmock.h>

using namespace ModrigUtils;
using testing::ElementsAre;
using testing::StrEq;

TEST(UnloadTip, SaysWhatTheButtonDoesWhenItCanBePressed)
{
    EXPECT_THAT(UnloadTip(true, {RowState::kLocked, RowState::kUsable}),
                ElementsAre(StrEq("IDS_MODRIG_UNLOAD_SELECTED")));
}

TEST(UnloadTip, SaysThatNothingIsLoaded)
{
    EXPECT_THAT(UnloadTip(false, {}), ElementsAre(StrEq("IDS_MODRIG_UNLOAD_NOTHING_LOADED")));
}

TEST(UnloadTip, AsksForASelectionWhereThereIsSomethingToSelect)
{
    EXPECT_THAT(UnloadTip(false, {RowState::kUsable}),
                ElementsAre(StrEq("IDS_MODRIG_UNLOAD_NOTHING_SELECTED")));
    EXPECT_THAT(UnloadTip(false, {RowState::kNeverUnloaded, RowState::kUsable}),
                ElementsAre(StrEq("IDS_MODRIG_UNLOAD_NOTHING_SELECTED"), StrEq("IDS_MODRIG_UNLOAD_NEVER")));
}

TEST(UnloadTip, GivesEveryReasonWhenNothingCanBeUnloaded)
{
    EXPECT_THAT(UnloadTip(false, {RowState::kLocked}),
                ElementsAre(StrEq("IDS_MODRIG_UNLOAD_NONE"), StrEq("IDS_MODRIG_UNLOAD_LOCKED")));
    EXPECT_THAT(UnloadTip(false, {RowState::kNeverUnloaded, RowState::kLocked, RowState::kLocked}),
                ElementsAre(StrEq("IDS_MODRIG_UNLOAD_NONE"), StrEq("IDS_MODRIG_UNLOAD_LOCKED"),
                            StrEq("IDS_MODRIG_UNLOAD_NEVER")));
}
