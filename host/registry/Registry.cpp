#include "host/registry/Registry.h"

#include <sqlite3.h>
#include <sys/stat.h>

#include <algorithm>

#include "host/Services.h"
#include "host/console/CommandLine.h"
#include "host/registry/Statement.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr int kBusyMilliseconds = 5000;
constexpr int kSchemaVersion = 1;
constexpr std::uintptr_t kFirstHandle = 0x1000;
// Written pages are handed to the file system after each of the first writes of a command and every so often
// later, so that a full disk shows at the write that it hits and the caller can tell its user.
constexpr unsigned kWritesFlushedAtOnce = 64;

constexpr const char* kSchema =
    "BEGIN IMMEDIATE;"
    "CREATE TABLE IF NOT EXISTS key(id INTEGER PRIMARY KEY AUTOINCREMENT,"
    " parent INTEGER NOT NULL REFERENCES key(id) ON DELETE CASCADE, name TEXT NOT NULL, fold TEXT NOT NULL,"
    " UNIQUE(parent, fold));"
    "CREATE TABLE IF NOT EXISTS value(seq INTEGER PRIMARY KEY AUTOINCREMENT,"
    " key INTEGER NOT NULL REFERENCES key(id) ON DELETE CASCADE, name TEXT NOT NULL, fold TEXT NOT NULL,"
    " data TEXT NOT NULL, UNIQUE(key, fold));"
    "CREATE INDEX IF NOT EXISTS value_order ON value(key, seq);"
    "CREATE INDEX IF NOT EXISTS key_order ON key(parent, id);"
    "INSERT OR IGNORE INTO key(id, parent, name, fold)"
    " VALUES(1, 1, 'HKEY_CURRENT_USER', 'hkey_current_user');"
    "PRAGMA user_version=1;"
    "COMMIT;";

LONG statusOf(int sqlite)
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

bool isMarkedReadOnly(const std::filesystem::path& file)
{
    struct stat status = {};
    return stat(file.c_str(), &status) == 0 && (status.st_mode & (S_IWUSR | S_IWGRP | S_IWOTH)) == 0;
}

std::wstring_view takePart(std::wstring_view& path)
{
    const std::size_t end = std::min(path.find(L'\\'), path.size());
    const std::wstring_view part = path.substr(0, end);
    path.remove_prefix(std::min(end + 1, path.size()));
    return part;
}

int firstNumber(sqlite3* database, const char* sql, int& number)
{
    Statement statement;
    int status = statement.prepare(database, sql);
    if (status == SQLITE_OK)
        status = statement.step();
    if (status != SQLITE_ROW)
        return status;
    number = static_cast<int>(statement.number(0));
    return SQLITE_OK;
}
} // namespace

struct Registry::Statements
{
    Statement findKey, keyExists, insertKey, deleteKey, subKeys;
    Statement readValue, writeValue, deleteValue, values, nextValue, valueAt;
    Statement begin, commit, rollback;

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
            {commit, "COMMIT"},
            {rollback, "ROLLBACK"}};
        for (const auto& [statement, sql] : all)
            if (const int status = statement.prepare(database, sql); status != SQLITE_OK)
                return status;
        return SQLITE_OK;
    }
};

Registry::Registry(std::filesystem::path file) : mFile(std::move(file)), mNextHandle(kFirstHandle)
{
    open();
}

Registry::~Registry()
{
    endOfCommand();
    mStatements.reset();
    sqlite3_close(mDatabase);
}

void Registry::open()
{
    mReadOnly = isMarkedReadOnly(mFile);
    if (openFile() != ERROR_SUCCESS || prepare() != ERROR_SUCCESS)
    {
        mProblem = L"The registry " + toWide(mFile.string()) + L" cannot be used: " + storeWords() +
                   L". It was left as it is, and nothing will be stored.";
        mStatements.reset();
        sqlite3_close(mDatabase);
        mDatabase = nullptr;
        return;
    }
    if (mReadOnly)
        mProblem = L"The registry " + toWide(mFile.string()) +
                   L" may only be read: what is stored there is used, and nothing new will be stored.";
}

LONG Registry::openFile()
{
    const int flags = mReadOnly ? SQLITE_OPEN_READONLY : SQLITE_OPEN_READWRITE | SQLITE_OPEN_CREATE;
    const int status = sqlite3_open_v2(mFile.c_str(), &mDatabase, flags | SQLITE_OPEN_NOMUTEX, nullptr);
    if (status != SQLITE_OK)
        return statusOf(status);
    mReadOnly = sqlite3_db_readonly(mDatabase, "main") == 1;
    return statusOf(sqlite3_busy_timeout(mDatabase, kBusyMilliseconds));
}

LONG Registry::checkOrigin(int& version)
{
    int tables = 0;
    int status = firstNumber(mDatabase, "PRAGMA user_version", version);
    if (status == SQLITE_OK && version < kSchemaVersion)
        status = firstNumber(mDatabase, "SELECT count(*) FROM sqlite_master", tables);
    if (version > kSchemaVersion)
        mFailureWords = L"it was written by a newer Tessel";
    // Another process may have made the registry between the two looks; then it says its version by now.
    else if (tables > 0 && firstNumber(mDatabase, "PRAGMA user_version", version) == SQLITE_OK &&
             version < kSchemaVersion)
        mFailureWords = L"it belongs to another program";
    return mFailureWords.empty() ? statusOf(status) : ERROR_ACCESS_DENIED;
}

// What is somebody else's is recognised before anything is written: the journal's kind is part of the file.
LONG Registry::prepare()
{
    int version = 0;
    if (const LONG status = checkOrigin(version); status != ERROR_SUCCESS)
        return status;
    const auto run = [this](const char* sql)
    {
        return sqlite3_exec(mDatabase, sql, nullptr, nullptr, nullptr);
    };
    int status = run("PRAGMA synchronous=FULL; PRAGMA foreign_keys=ON;");
    if (status == SQLITE_OK && version < kSchemaVersion && !mReadOnly)
        status = run(kSchema);
    mStatements = std::make_unique<Statements>();
    if (status == SQLITE_OK)
        status = mStatements->prepare(mDatabase);
    if (status == SQLITE_OK && !mReadOnly)
        status = run("PRAGMA journal_mode=WAL;");
    return statusOf(status);
}

std::wstring Registry::storeWords() const
{
    return mFailureWords.empty() ? toWide(sqlite3_errmsg(mDatabase)) : mFailureWords;
}

Registry::Key Registry::findChild(Key parent, std::wstring_view name)
{
    Statement& find = mStatements->findKey;
    if (!isRow(find.bind(parent).bind(foldCase(name)).step()))
        return kNoKey;
    const Key key = find.number(0);
    find.reset();
    return key;
}

Registry::Key Registry::find(std::wstring_view path, Key from)
{
    if (!mDatabase)
        return kNoKey;
    Key key = from;
    while (!path.empty() && key != kNoKey)
    {
        const std::wstring_view part = takePart(path);
        if (!part.empty())
            key = findChild(key, part);
    }
    return key;
}

LONG Registry::createChild(Key parent, std::wstring_view name, Key& key)
{
    if (const LONG status = beginWriting(); status != ERROR_SUCCESS)
        return status;
    // Another process may have made it before the transaction began.
    key = findChild(parent, name);
    if (key != kNoKey)
        return ERROR_SUCCESS;
    const int status = mStatements->insertKey.bind(parent).bind(name).bind(foldCase(name)).run();
    key = sqlite3_last_insert_rowid(mDatabase);
    return finishWrite(status);
}

LONG Registry::create(std::wstring_view path, Key from, Key& key)
{
    if (!mDatabase || mReadOnly)
    {
        // Opening an existing key is no write, but who opens it this way is about to write.
        return ERROR_ACCESS_DENIED;
    }
    key = from;
    while (!path.empty())
    {
        const std::wstring_view part = takePart(path);
        if (part.empty())
            continue;
        const Key parent = key;
        key = findChild(parent, part);
        if (key != kNoKey)
            continue;
        if (const LONG status = createChild(parent, part, key); status != ERROR_SUCCESS)
            return status;
    }
    return ERROR_SUCCESS;
}

std::vector<std::wstring> Registry::subKeys(Key key)
{
    std::vector<std::wstring> names;
    if (!mDatabase)
        return names;
    Statement& list = mStatements->subKeys;
    list.bind(key);
    while (isRow(list.step()))
        names.push_back(list.text(0));
    return names;
}

LONG Registry::removeKey(Key key)
{
    if (key == kNoKey || key == kRoot)
        return ERROR_INVALID_PARAMETER;
    if (const LONG status = beginWriting(); status != ERROR_SUCCESS)
        return status;
    mCursor = {};
    return finishWrite(mStatements->deleteKey.bind(key).run());
}

LONG Registry::readValue(Key key, std::wstring_view name, std::wstring& data)
{
    if (!mDatabase)
        return ERROR_FILE_NOT_FOUND;
    Statement& read = mStatements->readValue;
    const int status = read.bind(key).bind(foldCase(name)).step();
    if (!isRow(status))
        return status == SQLITE_DONE ? ERROR_FILE_NOT_FOUND : ERROR_READ_FAULT;
    data = read.text(0);
    read.reset();
    return ERROR_SUCCESS;
}

LONG Registry::writeValue(Key key, std::wstring_view name, std::wstring_view data)
{
    if (const LONG status = beginWriting(); status != ERROR_SUCCESS)
        return status;
    return finishWrite(mStatements->writeValue.bind(key).bind(name).bind(foldCase(name)).bind(data).run());
}

LONG Registry::removeValue(Key key, std::wstring_view name)
{
    if (const LONG status = beginWriting(); status != ERROR_SUCCESS)
        return status;
    mCursor = {};
    const LONG status = finishWrite(mStatements->deleteValue.bind(key).bind(foldCase(name)).run());
    if (status == ERROR_SUCCESS && sqlite3_changes(mDatabase) == 0)
        return ERROR_FILE_NOT_FOUND;
    return status;
}

LONG Registry::valueName(Key key, DWORD index, std::wstring& name)
{
    if (!mDatabase)
        return ERROR_NO_MORE_ITEMS;
    const bool next = mCursor.key == key && index == mCursor.index + 1;
    Statement& find = next || index == 0 ? mStatements->nextValue : mStatements->valueAt;
    find.bind(key).bind(next ? mCursor.sequence : std::int64_t{index});
    // A store that cannot be read has no more items either: whoever walks it must come to an end.
    if (!isRow(find.step()))
        return ERROR_NO_MORE_ITEMS;
    mCursor = {key, index, find.number(0)};
    name = find.text(1);
    find.reset();
    return ERROR_SUCCESS;
}

std::vector<Registry::Value> Registry::values(Key key)
{
    std::vector<Value> found;
    if (!mDatabase)
        return found;
    Statement& list = mStatements->values;
    list.bind(key);
    while (isRow(list.step()))
        found.push_back({list.text(0), list.text(1)});
    return found;
}

std::optional<std::wstring> Registry::read(std::wstring_view path, std::wstring_view name)
{
    const Key key = find(path);
    std::wstring data;
    if (key == kNoKey || readValue(key, name, data) != ERROR_SUCCESS)
        return std::nullopt;
    return data;
}

bool Registry::write(std::wstring_view path, std::wstring_view name, std::wstring_view data)
{
    Key key = kNoKey;
    return create(path, kRoot, key) == ERROR_SUCCESS && writeValue(key, name, data) == ERROR_SUCCESS;
}

LONG Registry::beginWriting()
{
    if (!mDatabase || mReadOnly)
        return ERROR_ACCESS_DENIED;
    if (mFailure != ERROR_SUCCESS)
        return mFailure;
    if (!sqlite3_get_autocommit(mDatabase))
        return ERROR_SUCCESS;
    mWrites = 0;
    const int status = mStatements->begin.run();
    return status == SQLITE_DONE ? ERROR_SUCCESS : fail(status, L"written");
}

LONG Registry::finishWrite(int status)
{
    if (status != SQLITE_DONE)
        return fail(status, L"written");
    ++mWrites;
    if (mWrites > kWritesFlushedAtOnce && mWrites % kWritesFlushedAtOnce != 0)
        return ERROR_SUCCESS;
    status = sqlite3_db_cacheflush(mDatabase);
    // Pages in use are flushed another time.
    return status == SQLITE_OK || status == SQLITE_BUSY ? ERROR_SUCCESS : fail(status, L"written");
}

// What could not be read must not be mistaken for what is not there and then be overwritten: no write of the
// command is stored after that.
bool Registry::isRow(int status)
{
    if (status != SQLITE_ROW && status != SQLITE_DONE)
        fail(status, L"read");
    return status == SQLITE_ROW;
}

// Undoes the command at once: until it ends it reads what was stored before, and not what half a command
// left.
LONG Registry::fail(int status, const wchar_t* done)
{
    if (mFailure != ERROR_SUCCESS)
        return mFailure;
    mFailure = statusOf(status);
    // Flushing leaves no words behind.
    const bool hasWords = sqlite3_errcode(mDatabase) != SQLITE_OK;
    const char* words = hasWords ? sqlite3_errmsg(mDatabase) : sqlite3_errstr(status);
    mFailureWords = std::wstring(L" could not be ") + done + L": " + toWide(words);
    // SQLite may have rolled back by itself already.
    if (!sqlite3_get_autocommit(mDatabase))
        mStatements->rollback.run();
    mCursor = {};
    closeHandlesOfLostKeys();
    return mFailure;
}

// The number of a key that was undone is given away again: a handle must not follow it to another key.
void Registry::closeHandlesOfLostKeys()
{
    std::erase_if(mHandles,
                  [this](const auto& handle)
                  {
                      Statement& find = mStatements->keyExists;
                      const bool lost = find.bind(handle.second).step() == SQLITE_DONE;
                      find.reset();
                      return lost;
                  });
}

bool Registry::endOfCommand()
{
    if (!mDatabase)
        return true;
    if (mFailure == ERROR_SUCCESS && !sqlite3_get_autocommit(mDatabase))
        if (const int status = mStatements->commit.run(); status != SQLITE_DONE)
            fail(status, L"written");
    if (mFailure == ERROR_SUCCESS)
        return true;
    if (services().commandLine)
        services().commandLine->say(L"The registry " + toWide(mFile.string()) + mFailureWords +
                                    L". What was stored before is unchanged.");
    mFailure = ERROR_SUCCESS;
    mFailureWords.clear();
    return false;
}

HKEY Registry::openHandle(Key key)
{
    const HKEY handle = reinterpret_cast<HKEY>(mNextHandle++);
    mHandles.emplace(handle, key);
    return handle;
}

std::optional<Registry::Key> Registry::keyOf(HKEY handle) const
{
    if (handle == HKEY_CURRENT_USER)
        return kRoot;
    const auto found = mHandles.find(handle);
    return found == mHandles.end() ? std::nullopt : std::optional(found->second);
}

bool Registry::closeHandle(HKEY handle)
{
    return handle == HKEY_CURRENT_USER || mHandles.erase(handle) > 0;
}

void ensureCurrentProfile(Registry& registry, std::wstring_view productRoot)
{
    const std::wstring profiles = std::wstring(productRoot) + L"\\Profiles";
    if (!registry.read(profiles, L""))
        registry.write(profiles, L"", L"Default");
}
} // namespace tessel
