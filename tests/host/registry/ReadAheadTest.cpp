#include "host/registry/ReadAhead.h"

#include <gtest/gtest.h>

#include <optional>
#include <string>
#include <utility>

#include "host/registry/RowChecksum.h"
#include "host/registry/Statement.h"

using tessel::checksumOfValue;
using tessel::ReadAhead;
using tessel::Statement;

namespace
{
constexpr std::int64_t kKey = 7;

// Four rows of one key, of which the one at 4 is damaged, and one of another key.
class ReadingAhead : public testing::Test
{
protected:
    void SetUp() override
    {
        ASSERT_EQ(sqlite3_open(":memory:", &mDatabase), SQLITE_OK);
        run("CREATE TABLE value(seq INTEGER PRIMARY KEY, key, name, fold, data, sum)");
        for (const auto& [key, fold] : {std::pair{7, "a"}, {7, "b"}, {7, "c"}, {7, "d"}, {8, "e"}})
            run("INSERT INTO value(key, name, fold, data, sum) VALUES(" + std::to_string(key) + ", '" + fold +
                "', '" + fold + "', '', " + std::to_string(checksumOfValue(key, fold, fold, "")) + ")");
        run("UPDATE value SET sum=sum+1 WHERE fold='d'");
        mRows.emplace();
        ASSERT_EQ(mRows->prepare(mDatabase, ReadAhead::kRowsAfter), SQLITE_OK);
    }
    void TearDown() override
    {
        mRows.reset();
        sqlite3_close(mDatabase);
    }

    void run(const std::string& sql)
    {
        ASSERT_EQ(sqlite3_exec(mDatabase, sql.c_str(), nullptr, nullptr, nullptr), SQLITE_OK);
    }
    int step(std::int64_t key, std::string_view fold) { return mAhead.step(*mRows, key, fold); }

    sqlite3* mDatabase = nullptr;
    std::optional<Statement> mRows;
    ReadAhead mAhead;
};
} // namespace

TEST_F(ReadingAhead, StepsAfterTwoNeighboursWereFoundAndNotBefore)
{
    EXPECT_EQ(step(kKey, "a"), SQLITE_DONE);
    mAhead.noteFound(kKey, 1);
    EXPECT_EQ(step(kKey, "b"), SQLITE_DONE);
    mAhead.noteFound(kKey, 2);
    EXPECT_EQ(step(kKey, "c"), SQLITE_ROW);
    EXPECT_TRUE(mRows->isStanding());
    EXPECT_EQ(mRows->number(0), 3);
}

TEST_F(ReadingAhead, GoesOnFromRowToRow)
{
    mAhead.noteFound(kKey, 0);
    mAhead.noteFound(kKey, 1);
    EXPECT_EQ(step(kKey, "b"), SQLITE_ROW);
    EXPECT_EQ(step(kKey, "c"), SQLITE_ROW);
    EXPECT_EQ(mRows->number(0), 3);
}

TEST_F(ReadingAhead, LeavesAnotherNameToTheSearchAndLetsTheRowGo)
{
    mAhead.noteFound(kKey, 0);
    mAhead.noteFound(kKey, 1);
    EXPECT_EQ(step(kKey, "c"), SQLITE_DONE);
    EXPECT_FALSE(mRows->isStanding());
    EXPECT_EQ(step(kKey, "b"), SQLITE_DONE) << "and begins only after the next two neighbours";
}

TEST_F(ReadingAhead, LeavesADamagedRowToTheSearch)
{
    mAhead.noteFound(kKey, 2);
    mAhead.noteFound(kKey, 3);
    EXPECT_EQ(step(kKey, "d"), SQLITE_DONE);
}

TEST_F(ReadingAhead, LeavesAnotherKeyToTheSearchAndLetsTheRowGo)
{
    mAhead.noteFound(kKey, 0);
    mAhead.noteFound(kKey, 1);
    ASSERT_EQ(step(kKey, "b"), SQLITE_ROW);
    EXPECT_EQ(step(8, "e"), SQLITE_DONE);
    EXPECT_FALSE(mRows->isStanding());
    mAhead.noteFound(8, 2);
    EXPECT_EQ(step(8, "e"), SQLITE_DONE) << "one row of a key is no order";
}

TEST_F(ReadingAhead, LeavesTheNameToTheSearchWhereTheNextRowIsAnotherKeysOfThatName)
{
    mAhead.noteFound(kKey, 3);
    mAhead.noteFound(kKey, 4);
    EXPECT_EQ(step(kKey, "e"), SQLITE_DONE);
    mAhead.noteFound(8, 3);
    mAhead.noteFound(8, 4);
    EXPECT_EQ(step(8, "e"), SQLITE_ROW) << "whose it is";
}

TEST_F(ReadingAhead, TakesLeapsForNoOrder)
{
    mAhead.noteFound(kKey, 0);
    mAhead.noteFound(kKey, 2);
    EXPECT_EQ(step(kKey, "c"), SQLITE_DONE);
}

TEST_F(ReadingAhead, KnowsNothingAfterItForgot)
{
    mAhead.noteFound(kKey, 0);
    mAhead.noteFound(kKey, 1);
    ASSERT_EQ(step(kKey, "b"), SQLITE_ROW);
    mAhead.forget(*mRows);
    EXPECT_FALSE(mRows->isStanding());
    EXPECT_EQ(step(kKey, "c"), SQLITE_DONE);
    mAhead.noteFound(kKey, 3);
    EXPECT_EQ(step(kKey, "d"), SQLITE_DONE);
}

TEST_F(ReadingAhead, TellsWhatFailedAndDoesNotGoOn)
{
    mAhead.noteFound(kKey, 0);
    mAhead.noteFound(kKey, 1);
    sqlite3_exec(mDatabase, "DROP TABLE value", nullptr, nullptr, nullptr);
    EXPECT_EQ(step(kKey, "b"), SQLITE_ERROR);
    EXPECT_EQ(step(kKey, "b"), SQLITE_DONE);
}
