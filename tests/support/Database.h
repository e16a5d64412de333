// The registry's file looked at past the registry, as another program does.
#pragma once

#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>
#include <utility>

#include <gtest/gtest.h>
#include <sqlite3.h>

#include "tests/support/Content.h"

// The first column of the first row, or the words of what went wrong.
inline std::string runSql(const std::filesystem::path& file, const char* sql)
{
    sqlite3* database = nullptr;
    sqlite3_open(file.c_str(), &database);
    std::string answer;
    const auto takeFirst = [](void* context, int, char** columns, char**)
    {
        auto& first = *static_cast<std::string*>(context);
        if (first.empty() && columns[0])
            first = columns[0];
        return 0;
    };
    if (sqlite3_exec(database, sql, takeFirst, &answer, nullptr) != SQLITE_OK)
        answer = sqlite3_errmsg(database);
    sqlite3_close(database);
    return answer;
}

// The one before the log, in which who writes locks out who reads: so it is in folders on a network.
inline void useOldJournal(const std::filesystem::path& file)
{
    EXPECT_EQ(runSql(file, "PRAGMA journal_mode=DELETE"), "delete");
}

// Another program, which has the file open and holds what its SQL locks until it lets go.
class DatabaseHolder
{
public:
    DatabaseHolder() = default;
    ~DatabaseHolder() { letGo(); }
    DatabaseHolder(const DatabaseHolder&) = delete;
    DatabaseHolder& operator=(const DatabaseHolder&) = delete;

    void hold(const std::filesystem::path& file, const char* by)
    {
        ASSERT_EQ(sqlite3_open(file.c_str(), &mDatabase), SQLITE_OK);
        ASSERT_EQ(sqlite3_exec(mDatabase, by, nullptr, nullptr, nullptr), SQLITE_OK) << by;
    }
    // What it has changed is in the file then, and what was there in the journal.
    void writeOut() { ASSERT_EQ(sqlite3_db_cacheflush(mDatabase), SQLITE_OK); }
    void letGo() { sqlite3_close(std::exchange(mDatabase, nullptr)); }

private:
    sqlite3* mDatabase = nullptr;
};
