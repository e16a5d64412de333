// The statements that the registry runs on its store, and what their answers mean. Used by the Registry's own
// files alone.
#pragma once

#include <sqlite3.h>

#include <utility>

#include "host/registry/Registry.h"
#include "host/registry/Statement.h"

namespace tessel
{
struct Registry::Statements
{
    Statement findKey, keyExists, insertKey, deleteKey, subKeys;
    Statement readValue, writeValue, deleteValue, values, nextValue, valueAt;
    Statement begin, beginReading, commit, rollback;

    int prepare(sqlite3* database)
    {
        const std::pair<Statement&, const char*> all[] = {
            {findKey, "SELECT id FROM key WHERE parent=? AND fold=? AND id<>1"},
            {keyExists, "SELECT 1 FROM key WHERE id=?"},
            {insertKey, "INSERT INTO key(parent,name,fold) VALUES(?,?,?)"},
            {deleteKey, "DELETE FROM key WHERE id=?"},
            {subKeys, "SELECT name FROM key WHERE parent=? AND id<>1 ORDER BY id"},
            {readValue, "SELECT data FROM value WHERE key=? AND fold=?"},
            {writeValue, "INSERT INTO value(key,name,fold,data) VALUES(?,?,?,?)"
                         " ON CONFLICT(key,fold) DO UPDATE SET data=excluded.data"},
            {deleteValue, "DELETE FROM value WHERE key=? AND fold=?"},
            {values, "SELECT name,data FROM value WHERE key=? ORDER BY seq"},
            {nextValue, "SELECT seq,name FROM value WHERE key=? AND seq>? ORDER BY seq LIMIT 1"},
            {valueAt, "SELECT seq,name FROM value WHERE key=? ORDER BY seq LIMIT 1 OFFSET ?"},
            {begin, "BEGIN IMMEDIATE"},
            {beginReading, "BEGIN"},
            {commit, "COMMIT"},
            {rollback, "ROLLBACK"}};
        for (const auto& [statement, sql] : all)
            if (const int status = statement.prepare(database, sql); status != SQLITE_OK)
                return status;
        return SQLITE_OK;
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
