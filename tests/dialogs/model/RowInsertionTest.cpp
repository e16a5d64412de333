#include "modrig/dialogs/model/RowInsertion.h"

#include <gtest/gtest.h>

using namespace ModrigUtils;

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
