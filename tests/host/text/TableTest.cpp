#include <gmock/gmock.h>

#include "host/text/DisplayWidth.h"
#include "host/text/Table.h"

using tessel::displayWidth;
using tessel::Table;
using testing::Each;
using testing::ElementsAre;
using testing::Le;
using testing::ResultOf;

namespace
{
Table files()
{
    Table table({4, 8});
    table.addHeading(L"Files in three folders:");
    table.add({L"moon.bundle", L"/home/ada", L"loaded in a very short time, and locked"});
    table.add({L"図面", L"/srv", L"Lisp"});
    return table;
}

std::size_t widthOf(const std::wstring& line)
{
    return displayWidth(line);
}
} // namespace

TEST(Table, HasALineForEachRowWhereNothingLimitsIt)
{
    EXPECT_THAT(files().lines(std::nullopt),
                ElementsAre(L"Files in three folders:",
                            L"  moon.bundle /home/ada loaded in a very short time, and locked",
                            L"  図面 /srv     Lisp"));
}

TEST(Table, HasColumnsAsWideAsTheirContent)
{
    EXPECT_THAT(files().lines(80),
                ElementsAre(L"Files in three folders:",
                            L"  moon.bundle  /home/ada  loaded in a very short time, and locked",
                            L"  図面         /srv       Lisp"));
}

TEST(Table, GoesOnBelowTheLastCell)
{
    const std::wstring below(26, L' ');
    EXPECT_THAT(files().lines(50),
                ElementsAre(L"Files in three folders:", L"  moon.bundle  /home/ada  loaded in a very short",
                            below + L"time, and locked", L"  図面         /srv       Lisp"));
}

TEST(Table, PutsCellsBelowTheFirstWhereTooLittleRoomIsLeft)
{
    EXPECT_THAT(files().lines(49),
                ElementsAre(L"Files in three folders:", L"  moon.bundle", L"      /home/ada",
                            L"      loaded in a very short time, and locked", L"  図面", L"      /srv",
                            L"      Lisp"));
}

TEST(Table, StaysWithinEveryWidthThatAWideCharacterFitsIn)
{
    for (const std::size_t cells : {4u, 8u, 15u, 24u, 49u, 50u, 79u})
        EXPECT_THAT(files().lines(cells), Each(ResultOf(widthOf, Le(std::max<std::size_t>(cells, 8)))))
            << cells;
}
