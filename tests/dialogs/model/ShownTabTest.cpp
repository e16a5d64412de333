#include "modrig/dialogs/model/ShownTab.h"

#include <gmock/gmock.h>

using namespace ModrigUtils;
using testing::Eq;
using testing::Optional;

namespace
{
constexpr int kAtTheEnd = -1;
} // namespace

TEST(ShownTab, ScrollsToRowsAddedAtItsEnd)
{
    EXPECT_THAT(TableToScroll(1, kAtTheEnd, 0), Optional(TableKind::kLoadedApplications));
    EXPECT_THAT(TableToScroll(2, kAtTheEnd, 1), Optional(TableKind::kHistory));
}

TEST(ShownTab, StaysWhenNothingWasAdded)
{
    EXPECT_THAT(TableToScroll(0, kAtTheEnd, 0), Eq(std::nullopt));
    EXPECT_THAT(TableToScroll(0, kAtTheEnd, 1), Eq(std::nullopt));
}

TEST(ShownTab, StaysWhereFilesWereDropped)
{
    EXPECT_THAT(TableToScroll(1, 0, 0), Eq(std::nullopt));
    EXPECT_THAT(TableToScroll(1, 3, 1), Eq(std::nullopt));
}

TEST(ShownTab, ScrollsNothingWhenItIsOfAnotherKind)
{
    EXPECT_THAT(TableToScroll(1, kAtTheEnd, 2), Eq(std::nullopt));
    EXPECT_THAT(TableToScroll(1, kAtTheEnd, -1), Eq(std::nullopt));
}
