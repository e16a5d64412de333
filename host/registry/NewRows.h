// Rows of values that a command has written and that are stored many at a time, by one statement: most of
// what a row costs is the beginning and the end of the statement that stores it. Used by the Registry's own
// files alone.
#pragma once

#include <sqlite3.h>

#include <cstdint>
#include <string>
#include <vector>

#include "host/registry/Statement.h"

namespace tessel
{
class NewRows
{
public:
    static constexpr std::size_t kAtOnce = 128;

    int prepare(sqlite3* database);

    // A value that is there already keeps its place and the spelling of its name.
    void add(std::int64_t key, std::string name, std::string fold, std::string data);

    bool isFull() const { return mRows.size() == kAtOnce; }

    // Stores those that have come since: SQLITE_DONE, or what failed.
    int store();

    // The transaction is over.
    void forget() { mRows.clear(); }

private:
    struct Row
    {
        std::int64_t key;
        std::string name;
        std::string fold;
        std::string data;
    };

    int storeBy(Statement& statement, std::size_t first, std::size_t count);

    sqlite3* mDatabase = nullptr;
    Statement mOne;
    Statement mMany;
    bool mHasMany = false; // it is long, and most sessions do without
    std::vector<Row> mRows;
};
} // namespace tessel
