#include "modrig/dialogs/model/RowInsertion.h"

#include <gmock/gmock.h>

#include <set>
#include <string>

#include "tests/dialogs/model/TableNames.h"

using namespace ModrigUtils;
using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
std::vector<TableKind> JoinedWhereHeld(bool savesHistory, const std::set<TableKind>& holding)
{
    return TablesToJoin(savesHistory, [&](TableKind kind) { return holding.contains(kind); });
}
} // namespace

TEST(RowForInsertion, IsTheEndWhenNothingWasDropped)
{
    EXPECT_EQ(5u, RowForInsertion(kAppendRow, 5));
}

TEST(RowForInsertion, IsWhereFilesWereDropped)
{
    EXPECT_EQ(3u, RowForInsertion(3, 5));
    EXPECT_EQ(0u, RowForInsertion(0, 5));
}

TEST(RowForInsertion, IsTheEndOfATableWithFewerRows)
{
    EXPECT_EQ(2u, RowForInsertion(5, 2));
}

TEST(TablesToJoin, AreBothForANewFileThatIsSavedInTheHistory)
{
    EXPECT_THAT(JoinedWhereHeld(true, {}), ElementsAre(kLoadedTable, kHistoryTable));
}

TEST(TablesToJoin, AreTheLoadedApplicationsAloneWhileNoHistoryIsSaved)
{
    EXPECT_THAT(JoinedWhereHeld(false, {}), ElementsAre(kLoadedTable));
    EXPECT_THAT(JoinedWhereHeld(false, {kLoadedTable}), IsEmpty());
}

TEST(TablesToJoin, LeaveOutWhatHasARowForTheFile)
{
    EXPECT_THAT(JoinedWhereHeld(true, {kLoadedTable}), ElementsAre(kHistoryTable));
    EXPECT_THAT(JoinedWhereHeld(true, {kHistoryTable}), ElementsAre(kLoadedTable));
    EXPECT_THAT(JoinedWhereHeld(true, {kLoadedTable, kHistoryTable}), IsEmpty());
}
