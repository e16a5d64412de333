#include "modrig/dialogs/model/RowSelection.h"

#include <gmock/gmock.h>

using namespace ModrigUtils;
using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
bool IsEven(std::size_t row)
{
    return row % 2 == 0;
}

bool MayBeSelectedAsLoaded(long row)
{
    return MayBeSelected(TableKind::kLoadedApplications, row, 3, IsEven);
}
} // namespace

TEST(RowSelection, IsOfUnloadableApplicationsInTheTableOfTheLoaded)
{
    EXPECT_TRUE(MayBeSelectedAsLoaded(0));
    EXPECT_FALSE(MayBeSelectedAsLoaded(1));
    EXPECT_TRUE(MayBeSelectedAsLoaded(2));
}

TEST(RowSelection, IsOfNoPlaceWithoutARowInTheTableOfTheLoaded)
{
    EXPECT_FALSE(MayBeSelectedAsLoaded(-2));
    EXPECT_FALSE(MayBeSelectedAsLoaded(4));
    EXPECT_FALSE(MayBeSelected(TableKind::kLoadedApplications, 0, 0, IsEven));
}

TEST(RowSelection, IsOfAnyRowInTheOtherTables)
{
    for (const TableKind kind : {TableKind::kHistory, TableKind::kStartupSuite})
        for (const long row : {-1L, 0L, 1L, 3L})
            EXPECT_TRUE(MayBeSelected(kind, row, 3, IsEven));
}

TEST(RowSelection, KeepsOfAnotherWhatMayBeSelected)
{
    EXPECT_THAT(SelectableOf({1, 4, 5, 8}, IsEven), ElementsAre(4u, 8u));
    EXPECT_THAT(SelectableOf({1, 5}, IsEven), IsEmpty());
    EXPECT_THAT(SelectableOf({}, IsEven), IsEmpty());
}

TEST(RowSelection, OfAllLeavesOutWhatMayNotBeSelected)
{
    EXPECT_THAT(AllSelectable(5, IsEven), ElementsAre(0u, 2u, 4u));
    EXPECT_THAT(AllSelectable(0, IsEven), IsEmpty());
}

TEST(RowSelection, IsWhatAMenuIsForWhenItIsOpenedOnASelectedRow)
{
    EXPECT_EQ(MenuRows::kSelection, RowsOfMenu(0, true, true));
    EXPECT_EQ(MenuRows::kSelection, RowsOfMenu(7, true, false));
}

TEST(RowSelection, GoesToTheRowThatAMenuIsOpenedOnIfThatMayBe)
{
    EXPECT_EQ(MenuRows::kNewSelection, RowsOfMenu(0, false, true));
    EXPECT_EQ(MenuRows::kUnselectedRow, RowsOfMenu(0, false, false));
}

TEST(RowSelection, IsNotWhatAMenuBesideTheRowsIsFor)
{
    for (const bool isSelected : {false, true})
        for (const bool mayBeSelected : {false, true})
            EXPECT_EQ(MenuRows::kNone, RowsOfMenu(-1, isSelected, mayBeSelected));
}
