// Opening the registry's file: whose it is, and whether it may be written.
#include <sys/stat.h>

#include <charconv>
#include <iterator>
#include <string_view>

#include "host/registry/Statements.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr int kSchemaVersion = 1;
constexpr const char* kAskVersion = "PRAGMA user_version";

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

bool isMarkedReadOnly(const std::filesystem::path& file)
{
    struct stat status = {};
    return stat(file.c_str(), &status) == 0 && (status.st_mode & (S_IWUSR | S_IWGRP | S_IWOTH)) == 0;
}

bool hasJournal(const std::filesystem::path& file)
{
    std::error_code missing;
    return std::filesystem::exists(file.string() + "-wal", missing);
}

// The file as one that nobody changes: it is then read without the journal's files beside it, which a folder
// that may not be written cannot take.
std::string fixedFile(const std::filesystem::path& file)
{
    std::string uri = "file:";
    for (const char character : std::filesystem::absolute(file).string())
    {
        if (std::string_view("%?#").find(character) == std::string_view::npos)
        {
            uri += character;
            continue;
        }
        char digits[2]; // each of these characters takes both
        std::to_chars(std::begin(digits), std::end(digits), static_cast<int>(character), 16);
        uri += '%' + std::string(digits, std::size(digits));
    }
    return uri + "?immutable=1";
}

// Why the store does not do what it was asked, in its own words: the end of a sentence.
Failure storeFailure(sqlite3* database, int status)
{
    return {toWide(sqlite3_errmsg(database)), status};
}

// The first number that a statement answers; the codes are the store's.
Result<int> firstNumber(sqlite3* database, const char* sql)
{
    Statement statement;
    int status = statement.prepare(database, sql);
    if (status == SQLITE_OK)
        status = statement.step();
    if (status != SQLITE_ROW)
        return storeFailure(database, status);
    return static_cast<int>(statement.number(0));
}
} // namespace

void Registry::open()
{
    mReadOnly = isMarkedReadOnly(mFile);
    Result<> ready = openFile();
    if (ready)
        ready = prepare();
    if (!ready)
    {
        mCanStore = Failure{L"The registry " + toWide(mFile.string()) + L" cannot be used: " +
                                ready.sentence() + L". It was left as it is, and nothing will be stored.",
                            ERROR_ACCESS_DENIED};
        mStatements.reset();
        sqlite3_close(mDatabase);
        mDatabase = nullptr;
    }
    else if (mReadOnly)
        mCanStore =
            Failure{L"The registry " + toWide(mFile.string()) +
                        L" may only be read: what is stored there is used, and nothing new will be stored.",
                    ERROR_ACCESS_DENIED};
}

Result<> Registry::openFile()
{
    const int flags = mReadOnly ? SQLITE_OPEN_READONLY : SQLITE_OPEN_READWRITE | SQLITE_OPEN_CREATE;
    int status = sqlite3_open_v2(mFile.c_str(), &mDatabase, flags | SQLITE_OPEN_NOMUTEX, nullptr);
    if (status != SQLITE_OK)
        return storeFailure(mDatabase, status);
    mReadOnly = sqlite3_db_readonly(mDatabase, "main") == 1;
    const int asked = firstNumber(mDatabase, kAskVersion).code();
    const bool journalRefused = mReadOnly && (asked == SQLITE_CANTOPEN || asked == SQLITE_READONLY);
    if (journalRefused && !hasJournal(mFile))
    {
        sqlite3_close(mDatabase);
        constexpr int kReadUri = SQLITE_OPEN_READONLY | SQLITE_OPEN_URI | SQLITE_OPEN_NOMUTEX;
        status = sqlite3_open_v2(fixedFile(mFile).c_str(), &mDatabase, kReadUri, nullptr);
    }
    if (status == SQLITE_OK)
        status = sqlite3_busy_timeout(mDatabase, static_cast<int>(mBusyTimeout.count()));
    return status == SQLITE_OK ? Result<>() : storeFailure(mDatabase, status);
}

// Whether the file is a registry that this host understands. Answers its version, 0 for a new one.
Result<int> Registry::checkOrigin()
{
    auto version = firstNumber(mDatabase, kAskVersion);
    if (!version || *version == kSchemaVersion)
        return version;
    if (*version > kSchemaVersion)
        return Failure{L"it was written by a newer Tessel"};
    auto tables = firstNumber(mDatabase, "SELECT count(*) FROM sqlite_master");
    if (!tables)
        return tables;
    if (*tables == 0)
        return version;
    // Another process may have made the registry between the two looks; then it says its version by now.
    auto versionNow = firstNumber(mDatabase, kAskVersion);
    if (versionNow && *versionNow < kSchemaVersion)
        return Failure{L"it belongs to another program"};
    return versionNow;
}

// What is somebody else's is recognised before anything is written: the journal's kind is part of the file.
Result<> Registry::prepare()
{
    const auto version = checkOrigin();
    if (!version)
        return version.failure();
    const auto run = [this](const char* sql)
    {
        return sqlite3_exec(mDatabase, sql, nullptr, nullptr, nullptr);
    };
    int status = run("PRAGMA synchronous=FULL; PRAGMA foreign_keys=ON;");
    if (status == SQLITE_OK && *version < kSchemaVersion && !mReadOnly)
        status = run(kSchema);
    mStatements = std::make_unique<Statements>();
    if (status == SQLITE_OK)
        status = mStatements->prepare(mDatabase);
    if (status == SQLITE_OK && !mReadOnly)
    {
        status = run("PRAGMA journal_mode=WAL;");
        // Another process is about to change the journal's kind; until then the old one keeps the promises
        // too.
        if (status == SQLITE_BUSY)
            return {};
    }
    return status == SQLITE_OK ? Result<>() : storeFailure(mDatabase, status);
}
} // namespace tessel
