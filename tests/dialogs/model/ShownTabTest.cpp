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

TEST(ShownTab, IsTheOneWhoseNumberIsTyped)
{
    EXPECT_THAT(TabForKey(L'1'), Optional(kLoadedApplicationsTab));
    EXPECT_THAT(TabForKey(L'2'), Optional(kHistoryTab));
}

TEST(ShownTab, StaysForOtherKeys)
{
    for (const wchar_t key : {L'0', L'3', L'9', L'a', L'\0'})
        EXPECT_THAT(TabForKey(key), Eq(std::nullopt)) << static_cast<int>(key);
}
