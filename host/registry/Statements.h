// The statements that the registry runs on its store, and what their answers mean. Used by the Registry's own
// files alone.
#pragma once

#include <sqlite3.h>

#include <cstdint>
#include <string>
#include <utility>

#include "host/registry/NewRows.h"
#include "host/registry/Registry.h"
#include "host/registry/RemovedRows.h"
#include "host/registry/Statement.h"

namespace tessel
{
struct Registry::Statements
{
    Statement findKey, keyExists, insertKey, deleteKey, subKeys;
    Statement readValue, followingValues, deleteValue, values, nextValues, valueAt;
    Statement begin, mark, beginReading, commit, rollback;
    NewRows added;
    RemovedRows removed;

    // `mark` writes the number of the file, by which its journals are known. A row that is found comes with
    // whether it is what was stored under what was asked for: an index may lead to another one.
    int prepare(sqlite3* database, std::int64_t fileNumber)
    {
        const std::string marking = "PRAGMA application_id=" + std::to_string(fileNumber);
        const std::pair<Statement&, const char*> all[] = {
            {findKey,
             "SELECT id, sum IS row_sum(?1, name, ?2) FROM key WHERE parent=?1 AND fold=?2 AND id<>1"},
            {keyExists, "SELECT 1 FROM key WHERE id=?"},
            {insertKey, "INSERT INTO key(parent, name, fold, sum) VALUES(?1, ?2, ?3, row_sum(?1, ?2, ?3))"},
            {deleteKey, "DELETE FROM key WHERE id=?"},
            {subKeys, "SELECT id, sum IS row_sum(?1, name, fold), name FROM key WHERE parent=?1 AND id<>1 "
                      "ORDER BY id"},
            {readValue,
             "SELECT seq, sum IS row_sum(?1, name, ?2, data), data FROM value WHERE key=?1 AND fold=?2"},
            {followingValues, ReadAhead::kRowsAfter},
            {deleteValue, "DELETE FROM value WHERE key=? AND fold=?"},
            {values, "SELECT seq, sum IS row_sum(?1, name, fold, data), name, data FROM value WHERE key=?1"
                     " ORDER BY seq"},
            {nextValues, "SELECT seq, sum IS row_sum(?1, name, fold, data), name FROM value"
                         " WHERE key=?1 AND seq>?2 ORDER BY seq"},
            {valueAt, "SELECT seq, sum IS row_sum(?1, name, fold, data), name FROM value"
                      " WHERE key=?1 ORDER BY seq LIMIT 1 OFFSET ?2"},
            {begin, "BEGIN IMMEDIATE"},
            {mark, marking.c_str()},
            {beginReading, "BEGIN"},
            {commit, "COMMIT"},
            {rollback, "ROLLBACK"}};
        for (const auto& [statement, sql] : all)
            if (const int status = statement.prepare(database, sql); status != SQLITE_OK)
                return status;
        const int status = added.prepare(database);
        return status == SQLITE_OK ? removed.prepare(database) : status;
    }
};

// A status of the store as a status of the registry calls.
inline LONG statusOf(int sqlite)
{
    switch (sqlite & 0xFF)
    {
    case SQLITE_OK:
    case SQLITE_DONE:
        return ERROR_SUCCESS;
    case SQLITE_FULL:
        return ERROR_DISK_FULL;
    case SQLITE_READONLY:
    case SQLITE_PERM:
    case SQLITE_AUTH:
        return ERROR_ACCESS_DENIED;
    default:
        return ERROR_WRITE_FAULT;
    }
}
} // namespace tessel
