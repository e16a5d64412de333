#include "modrig/dialogs/model/RowSteps.h"

#include <gmock/gmock.h>

#include "modrig/dialogs/model/TableActions.h"

using namespace ModrigUtils;
using testing::Eq;
using testing::Optional;

namespace
{
// Of ten rows, 3, 4 and 7 can be selected.
std::optional<std::size_t> From(std::optional<std::size_t> selected, wchar_t key)
{
    return RowForKey(key, {.rows = 10, .page = 3, .selected = selected},
                     [](std::size_t row) { return row == 3 || row == 4 || row == 7; });
}
} // namespace

TEST(RowSteps, PassOverRowsThatCannotBeSelected)
{
    EXPECT_THAT(From(4, kDownKey), Optional(7u));
    EXPECT_THAT(From(7, kUpKey), Optional(4u));
    EXPECT_THAT(From(3, kDownKey), Optional(4u));
}

TEST(RowSteps, StayWhereNothingFurtherCanBeSelected)
{
    EXPECT_THAT(From(7, kDownKey), Optional(7u));
    EXPECT_THAT(From(3, kUpKey), Optional(3u));
    EXPECT_THAT(From(7, kPageDownKey), Optional(7u));
}

TEST(RowSteps, GoToTheFirstAndTheLastRowThatCanBeSelected)
{
    for (const auto& selected : {std::optional<std::size_t>(), std::optional<std::size_t>(4)})
    {
        EXPECT_THAT(From(selected, kHomeKey), Optional(3u));
        EXPECT_THAT(From(selected, kEndKey), Optional(7u));
    }
}

TEST(RowSteps, GoAPageOrBeyond)
{
    EXPECT_THAT(From(4, kPageDownKey), Optional(7u));
    EXPECT_THAT(From(3, kPageDownKey), Optional(7u));
    EXPECT_THAT(From(7, kPageUpKey), Optional(4u));
}

TEST(RowSteps, BeginAtTheEndThatTheKeyComesFrom)
{
    EXPECT_THAT(From(std::nullopt, kDownKey), Optional(3u));
    EXPECT_THAT(From(std::nullopt, kUpKey), Optional(7u));
}

TEST(RowSteps, LeadNowhereWithoutARowOrForOtherKeys)
{
    EXPECT_THAT(From(4, L'x'), Eq(std::nullopt));
    EXPECT_THAT(RowForKey(kDownKey, {}, [](std::size_t) { return true; }), Eq(std::nullopt));
    EXPECT_THAT(
        RowForKey(kDownKey, {.rows = 3, .page = 1, .selected = {}}, [](std::size_t) { return false; }),
        Eq(std::nullopt));
}

TEST(RowSteps, NeedHelpOnlyWhereTheToolkitWouldComeToAnotherRow)
{
    const auto passedOver = [](std::size_t selected, wchar_t key)
    {
        return RowPassedOverFor(key, {.rows = 10, .page = 3, .selected = selected},
                                [](std::size_t row) { return row == 3 || row == 4 || row == 7; });
    };
    EXPECT_THAT(passedOver(4, kDownKey), Optional(7u));
    EXPECT_THAT(passedOver(7, kDownKey), Optional(7u));
    EXPECT_THAT(passedOver(3, kDownKey), Eq(std::nullopt));
    EXPECT_THAT(passedOver(3, L'x'), Eq(std::nullopt));
}
