#include "host/registry/Schema.h"

#include <array>
#include <random>
#include <string_view>

#include "host/registry/RowChecksum.h"
#include "host/registry/Statement.h"
#include "host/registry/StoreFailure.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
struct Definition
{
    const char* name;
    const char* sql; // as the store keeps it
};

constexpr Definition kKeyTable = {
    "key", "CREATE TABLE key(id INTEGER PRIMARY KEY AUTOINCREMENT,"
           " parent INTEGER NOT NULL REFERENCES key(id) ON DELETE CASCADE, name TEXT NOT NULL,"
           " fold TEXT NOT NULL, sum INTEGER NOT NULL, UNIQUE(parent, fold))"};
constexpr Definition kValueTable = {
    "value", "CREATE TABLE value(seq INTEGER PRIMARY KEY AUTOINCREMENT,"
             " key INTEGER NOT NULL REFERENCES key(id) ON DELETE CASCADE, name TEXT NOT NULL,"
             " fold TEXT NOT NULL, data TEXT NOT NULL, sum INTEGER NOT NULL, UNIQUE(key, fold))"};
constexpr Definition kValueOrder = {"value_order", "CREATE INDEX value_order ON value(key, seq)"};
constexpr Definition kKeyOrder = {"key_order", "CREATE INDEX key_order ON key(parent, id)"};

constexpr Definition kOldKeyTable = {
    "key", "CREATE TABLE key(id INTEGER PRIMARY KEY AUTOINCREMENT,"
           " parent INTEGER NOT NULL REFERENCES key(id) ON DELETE CASCADE, name TEXT NOT NULL, fold TEXT NOT "
           "NULL, UNIQUE(parent, fold))"};
constexpr Definition kOldValueTable = {
    "value",
    "CREATE TABLE value(seq INTEGER PRIMARY KEY AUTOINCREMENT,"
    " key INTEGER NOT NULL REFERENCES key(id) ON DELETE CASCADE, name TEXT NOT NULL, fold TEXT NOT NULL,"
    " data TEXT NOT NULL, UNIQUE(key, fold))"};

constexpr std::array kTables = {kKeyTable, kValueTable, kValueOrder, kKeyOrder};
constexpr std::array kOldTables = {kOldKeyTable, kOldValueTable, kValueOrder, kKeyOrder};

constexpr const char* kRoot =
    "INSERT INTO key(id, parent, name, fold, sum) VALUES(1, 1, 'HKEY_CURRENT_USER', 'hkey_current_user',"
    " row_sum(1, 'HKEY_CURRENT_USER', 'hkey_current_user'))";

// The numbers that were given away stay so, also those of rows that are gone.
constexpr std::array kTakeOver = {
    "INSERT INTO key(id, parent, name, fold, sum)"
    " SELECT id, parent, name, fold, row_sum(parent, name, fold) FROM old_key",
    "INSERT INTO value(seq, key, name, fold, data, sum)"
    " SELECT seq, key, name, fold, data, row_sum(key, name, fold, data) FROM old_value",
    "UPDATE sqlite_sequence SET seq=(SELECT seq FROM sqlite_sequence WHERE name='old_key')"
    " WHERE name='key' AND EXISTS(SELECT 1 FROM sqlite_sequence WHERE name='old_key')",
    "UPDATE sqlite_sequence SET seq=(SELECT seq FROM sqlite_sequence WHERE name='old_value')"
    " WHERE name='value' AND EXISTS(SELECT 1 FROM sqlite_sequence WHERE name='old_value')",
    "DROP TABLE old_value",
    "DROP TABLE old_key"};

constexpr std::array kMakeRoom = {"DROP INDEX value_order", "DROP INDEX key_order",
                                  "ALTER TABLE value RENAME TO old_value",
                                  "ALTER TABLE key RENAME TO old_key"};

void rowSum(sqlite3_context* context, int count, sqlite3_value** values)
{
    RowChecksum sum;
    for (int i = 0; i < count; ++i)
    {
        sqlite3_value* const value = values[i];
        if (sqlite3_value_type(value) == SQLITE_INTEGER)
        {
            sum.add(sqlite3_value_int64(value));
            continue;
        }
        if (sqlite3_value_type(value) == SQLITE_NULL)
            continue;
        // As bytes, for which the store makes no copy that ends with a zero.
        const auto* bytes = static_cast<const char*>(sqlite3_value_blob(value));
        const auto size = static_cast<std::size_t>(sqlite3_value_bytes(value));
        sum.add(bytes ? std::string_view(bytes, size) : std::string_view());
    }
    sqlite3_result_int64(context, sum.finish());
}

Result<> run(sqlite3* database, const char* sql)
{
    const int status = sqlite3_exec(database, sql, nullptr, nullptr, nullptr);
    return status == SQLITE_OK ? Result<>() : storeFailure(database, status);
}

// What the column's reader makes of the first row that the statement answers.
template <class Value>
Result<Value> first(sqlite3* database, const char* sql, Value (Statement::*column)(int) const)
{
    Statement statement;
    int status = statement.prepare(database, sql);
    if (status == SQLITE_OK)
        status = statement.step();
    return status == SQLITE_ROW ? Result<Value>((statement.*column)(0)) : storeFailure(database, status);
}

template <class Statements>
Result<> runAll(sqlite3* database, const Statements& statements)
{
    for (const char* sql : statements)
        if (auto done = run(database, sql); !done)
            return done;
    return {};
}

Result<> makeDefinitions(sqlite3* database)
{
    for (const Definition& definition : kTables)
        if (auto made = run(database, definition.sql); !made)
            return made;
    return {};
}

// A number that tells this file from all others, by which its journals are known, and the version.
Result<> mark(sqlite3* database)
{
    constexpr std::uint32_t kLargest = 0x7FFFFFFF;
    std::random_device random;
    const std::uint32_t number = random() % kLargest + 1;
    const std::string sql = "PRAGMA application_id=" + std::to_string(number) +
                            "; PRAGMA user_version=" + std::to_string(kSchemaVersion);
    return run(database, sql.c_str());
}

// The work as one transaction, begun while nobody else writes.
template <class Work>
Result<> inOneTransaction(sqlite3* database, int versionBefore, Work work)
{
    if (auto begun = run(database, "BEGIN IMMEDIATE"); !begun)
        return begun;
    Result<> done;
    const auto version = firstNumber(database, "PRAGMA user_version");
    if (!version)
        done = version.failure();
    else if (*version == versionBefore) // otherwise another process was first
        done = work();
    if (done)
        done = run(database, "COMMIT");
    if (!done)
        static_cast<void>(run(database, "ROLLBACK")); // the store may have done so by itself
    return done;
}

std::string textOf(const Statement& statement, int column)
{
    return toUtf8(statement.text(column));
}

template <class Definitions>
bool isDefined(const Definitions& definitions, const std::string& name, const std::string& sql)
{
    for (const Definition& definition : definitions)
        if (name == definition.name)
            return sql == definition.sql;
    return false;
}

// What the store makes for itself and runs nothing: indexes of unique columns, numbers given away,
// statistics.
bool isOfTheStore(const std::string& type, const std::string& name)
{
    return (type == "table" || type == "index") && name.starts_with("sqlite_");
}
} // namespace

int addChecksum(sqlite3* database)
{
    constexpr int kFlags = SQLITE_UTF8 | SQLITE_DETERMINISTIC | SQLITE_DIRECTONLY;
    return sqlite3_create_function_v2(database, "row_sum", -1, kFlags, nullptr, rowSum, nullptr, nullptr,
                                      nullptr);
}

Result<> checkTables(sqlite3* database, int version)
{
    const auto& definitions = version == kSchemaVersion ? kTables : kOldTables;
    Statement all;
    int status = all.prepare(database, "SELECT type, name, ifnull(sql, '') FROM sqlite_master");
    std::size_t known = 0;
    while (status == SQLITE_OK || status == SQLITE_ROW)
    {
        status = all.step();
        if (status != SQLITE_ROW)
            break;
        const std::string name = textOf(all, 1);
        if (isDefined(definitions, name, textOf(all, 2)))
            ++known;
        else if (!isOfTheStore(textOf(all, 0), name))
            return Failure{translated(L"its {} \"{}\" is not as Tessel makes it, and could do anything",
                                      all.text(0), all.text(1)),
                           SQLITE_CORRUPT};
    }
    if (status != SQLITE_DONE)
        return storeFailure(database, status);
    return known == definitions.size() ? Result<>()
                                       : Failure{translated(L"tables of it are missing"), SQLITE_CORRUPT};
}

Result<> makeTables(sqlite3* database)
{
    return inOneTransaction(database, 0,
                            [database]
                            {
                                auto made = makeDefinitions(database);
                                if (made)
                                    made = run(database, kRoot);
                                return made ? mark(database) : made;
                            });
}

Result<> addChecksums(sqlite3* database)
{
    // The old tables go with their rows, which are those of the new ones by then.
    if (auto off = run(database, "PRAGMA foreign_keys=OFF"); !off)
        return off;
    auto done = inOneTransaction(database, kVersionWithoutChecksums,
                                 [database]
                                 {
                                     auto taken = runAll(database, kMakeRoom);
                                     if (taken)
                                         taken = makeDefinitions(database);
                                     if (taken)
                                         taken = runAll(database, kTakeOver);
                                     return taken ? mark(database) : taken;
                                 });
    const auto on = run(database, "PRAGMA foreign_keys=ON");
    return done ? on : done;
}

Result<std::string> emptyRegistry()
{
    sqlite3* database = nullptr;
    int status = sqlite3_open(":memory:", &database);
    if (status == SQLITE_OK)
        status = addChecksum(database);
    Result<std::string> bytes = storeFailure(database, status);
    if (status == SQLITE_OK)
    {
        const auto made = makeTables(database);
        sqlite3_int64 size = 0;
        unsigned char* image = made ? sqlite3_serialize(database, "main", &size, 0) : nullptr;
        bytes = image ? Result<std::string>(std::string(image, image + size))
                      : (made ? storeFailure(database, SQLITE_NOMEM) : made.failure());
        sqlite3_free(image);
    }
    sqlite3_close(database);
    return bytes;
}

Result<std::int64_t> firstNumber(sqlite3* database, const char* sql)
{
    return first(database, sql, &Statement::number);
}

Result<std::wstring> firstText(sqlite3* database, const char* sql)
{
    return first(database, sql, &Statement::text);
}
} // namespace tessel
