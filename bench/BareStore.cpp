#include "bench/BareStore.h"

#include <sqlite3.h>

#include <vector>

namespace bench
{
namespace
{
class Store
{
public:
    Store(const std::filesystem::path& file, int flags)
    {
        if (sqlite3_open_v2(file.c_str(), &mDatabase, flags, nullptr) != SQLITE_OK)
            mBroken = true;
    }
    ~Store() { sqlite3_close(mDatabase); }
    Store(const Store&) = delete;
    Store& operator=(const Store&) = delete;

    sqlite3* get() const { return mDatabase; }
    bool run(const char* sql)
    {
        return !mBroken && sqlite3_exec(mDatabase, sql, nullptr, nullptr, nullptr) == SQLITE_OK;
    }

private:
    sqlite3* mDatabase = nullptr;
    bool mBroken = false;
};

class Query
{
public:
    Query(const Store& store, const char* sql)
    {
        mReady = sqlite3_prepare_v2(store.get(), sql, -1, &mStatement, nullptr) == SQLITE_OK;
    }
    ~Query() { sqlite3_finalize(mStatement); }
    Query(const Query&) = delete;
    Query& operator=(const Query&) = delete;

    void bind(int place, sqlite3_int64 number) { sqlite3_bind_int64(mStatement, place, number); }
    void bind(int place, const std::string& text)
    {
        sqlite3_bind_text(mStatement, place, text.data(), static_cast<int>(text.size()), SQLITE_STATIC);
    }
    bool hasRow() { return mReady && sqlite3_step(mStatement) == SQLITE_ROW; }
    bool run()
    {
        const bool done = mReady && sqlite3_step(mStatement) == SQLITE_DONE;
        sqlite3_reset(mStatement);
        return done;
    }
    void reset() { sqlite3_reset(mStatement); }
    sqlite3_int64 number() const { return sqlite3_column_int64(mStatement, 0); }
    std::string text() const
    {
        return {reinterpret_cast<const char*>(sqlite3_column_text(mStatement, 0)),
                static_cast<std::size_t>(sqlite3_column_bytes(mStatement, 0))};
    }

private:
    sqlite3_stmt* mStatement = nullptr;
    bool mReady = false;
};

std::string foldOf(std::size_t number)
{
    return std::to_string(number) + "history";
}

// The History that holds so many; each size has a profile of its own.
sqlite3_int64 historyOf(const Store& store, std::size_t count)
{
    const std::string size = std::to_string(count);
    Query find(store,
               "SELECT key.id FROM key CROSS JOIN value ON value.key=key.id AND value.fold='numhistory'"
               " WHERE value.data=?1");
    find.bind(1, size);
    return find.hasRow() ? find.number() : 0;
}

std::vector<std::string> definitionsIn(const Store& store)
{
    std::vector<std::string> definitions;
    Query list(store, "SELECT sql FROM sqlite_master WHERE sql IS NOT NULL AND name NOT LIKE 'sqlite%'");
    while (list.hasRow())
        definitions.push_back(list.text());
    return definitions;
}

bool removeAll(const Store& store, std::size_t count)
{
    Query remove(store, "DELETE FROM value WHERE key=?1 AND fold=?2");
    bool all = true;
    for (std::size_t number = 1; number <= count; ++number)
    {
        const std::string fold = foldOf(number);
        remove.bind(1, 1);
        remove.bind(2, fold);
        all = remove.run() && all;
    }
    return all;
}

bool insertAll(const Store& store, std::size_t count, PathOf pathOf)
{
    Query insert(store, "INSERT INTO value(key, name, fold, data, sum) VALUES(?1, ?2, ?3, ?4, ?1)");
    bool all = true;
    for (std::size_t number = 1; number <= count; ++number)
    {
        const std::string name = entryName(number);
        const std::string fold = foldOf(number);
        const std::string path = pathOf(number - 1);
        insert.bind(1, 1);
        insert.bind(2, name);
        insert.bind(3, fold);
        insert.bind(4, path);
        all = insert.run() && all;
    }
    return all;
}

bool readAll(Store& store, std::size_t count)
{
    if (!store.run("BEGIN"))
        return false;
    bool all = true;
    {
        const sqlite3_int64 key = historyOf(store, count);
        Query read(store, "SELECT data FROM value WHERE key=?1 AND fold=?2");
        for (std::size_t number = 1; number <= count; ++number)
        {
            const std::string fold = foldOf(number);
            read.bind(1, key);
            read.bind(2, fold);
            all = read.hasRow() && !read.text().empty() && all;
            read.reset();
        }
    }
    return store.run("COMMIT") && all;
}
} // namespace

bool makeBare(const std::filesystem::path& registry, const std::filesystem::path& file)
{
    std::filesystem::remove(file);
    const Store model(registry, SQLITE_OPEN_READONLY);
    Store store(file, SQLITE_OPEN_READWRITE | SQLITE_OPEN_CREATE);
    bool made = store.run("PRAGMA journal_mode=WAL");
    for (const std::string& definition : definitionsIn(model))
        made = store.run(definition.c_str()) && made;
    return made && store.run("INSERT INTO key VALUES(1, 1, 'root', 'root', 0)");
}

class BareStore::Connection : public Store
{
public:
    using Store::Store;
};

BareStore::BareStore(const std::filesystem::path& file)
    : mConnection(std::make_unique<Connection>(file, SQLITE_OPEN_READWRITE))
{
}

BareStore::~BareStore() = default;

bool BareStore::read(std::size_t count)
{
    return readAll(*mConnection, count);
}

bool BareStore::write(std::size_t count, bool removeFirst, PathOf pathOf)
{
    bool written = mConnection->run("PRAGMA synchronous=FULL") && mConnection->run("BEGIN IMMEDIATE");
    if (removeFirst)
        written = removeAll(*mConnection, count) && written;
    written = insertAll(*mConnection, count, pathOf) && written;
    return mConnection->run("COMMIT") && written;
}
} // namespace bench
