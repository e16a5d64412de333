// Opening the registry's file: whose it is, whether it is sound, and whether it may be written.
#include <sys/stat.h>

#include <chrono>
#include <cstring>
#include <random>
#include <thread>

#include "host/platform/NetworkFolder.h"
#include "host/platform/OrdinaryFile.h"
#include "host/registry/Journals.h"
#include "host/registry/LongStatements.h"
#include "host/registry/Schema.h"
#include "host/registry/SoundCopy.h"
#include "host/registry/Soundness.h"
#include "host/registry/Statements.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr const char* kAskVersion = "PRAGMA user_version";
constexpr const char* kUseLog = "PRAGMA journal_mode=WAL";
constexpr const char* kUseJournal = "PRAGMA journal_mode=DELETE";

// Where a file says that it has a write-ahead log: 2, or 1 when it has none.
constexpr std::size_t kJournalKind = 18;
constexpr std::size_t kJournalKindBytes = 2;

bool isMarkedReadOnly(const std::filesystem::path& file)
{
    struct stat status = {};
    return stat(file.c_str(), &status) == 0 && (status.st_mode & (S_IWUSR | S_IWGRP | S_IWOTH)) == 0;
}

bool holdsSomething(const std::filesystem::path& file)
{
    struct stat status = {};
    return stat(file.c_str(), &status) == 0 && (!S_ISREG(status.st_mode) || status.st_size > 0);
}

// Opening what is no file at all would fail in words that do not say so, or wait.
Result<> checkKind(const std::filesystem::path& file)
{
    struct stat status = {};
    if (stat(file.c_str(), &status) != 0)
        return {};
    const auto ordinary = checkOrdinary(status);
    return ordinary ? ordinary : Failure{ordinary.sentence(), SQLITE_NOTADB};
}

bool fileExists(const std::filesystem::path& file)
{
    std::error_code missing;
    return std::filesystem::exists(file, missing);
}

bool isNewer(const std::filesystem::path& file, const std::filesystem::path& other)
{
    std::error_code missing;
    const auto time = std::filesystem::last_write_time(file, missing);
    return !missing && time > std::filesystem::last_write_time(other, missing) && !missing;
}

// The file may come from anybody: nothing in it runs, and no statement can be made to harm its tables.
int makeSafe(sqlite3* database)
{
    const auto set = [database](int option, int value)
    {
        return sqlite3_db_config(database, option, value, nullptr);
    };
    int status = set(SQLITE_DBCONFIG_DEFENSIVE, 1);
    for (const int option :
         {SQLITE_DBCONFIG_TRUSTED_SCHEMA, SQLITE_DBCONFIG_ENABLE_TRIGGER, SQLITE_DBCONFIG_ENABLE_VIEW})
        if (status == SQLITE_OK)
            status = set(option, 0);
    return status == SQLITE_OK ? addChecksum(database) : status;
}

bool isDamage(int status)
{
    const int kind = status & 0xFF;
    return kind == SQLITE_CORRUPT || kind == SQLITE_NOTADB;
}

// What may be so because nothing can be written where the file is.
bool isRefusal(int status)
{
    const int kind = status & 0xFF;
    return kind == SQLITE_CANTOPEN || kind == SQLITE_READONLY || kind == SQLITE_IOERR ||
           kind == SQLITE_FULL || kind == SQLITE_PERM;
}
} // namespace

void Registry::open()
{
    mReadOnly = isMarkedReadOnly(mFile);
    mLeftOpen = hasJournal(mFile);
    Result<> ready = checkKind(mFile);
    if (ready)
        ready = makeMissingFile();
    if (ready)
        ready = openFile();
    if (ready)
        ready = prepare();
    if (!ready)
        refuse(ready);
    else if (mReadOnly && mCanStore)
        mCanStore =
            Failure{L"The registry " + toWide(mFile.string()) +
                        L" may only be read: what is stored there is used, and nothing new will be stored.",
                    ERROR_ACCESS_DENIED};
}

void Registry::close()
{
    mStatements.reset();
    sqlite3_close(mDatabase);
    mDatabase = nullptr;
}

void Registry::refuse(const Result<>& reason)
{
    mDamaged = isDamage(reason.code());
    mCanStore = Failure{L"The registry " + toWide(mFile.string()) + L" cannot be used: " + reason.sentence() +
                            L". It was left as it is, and nothing will be stored." +
                            (mDamaged ? L" " + helpAgainstDamage(mFile) : std::wstring()),
                        ERROR_ACCESS_DENIED};
    close();
}

// A new file appears with all that it needs: of many first starts none sees half of it. One that was there
// once is not made again, for then its copy would be the next to go.
Result<> Registry::makeMissingFile()
{
    const bool hasCopy = fileExists(soundCopyOf(mFile));
    if (holdsSomething(mFile))
        return {};
    if (hasCopy)
        return Failure{L"it is empty or missing, but the copy of what it held is there", SQLITE_CORRUPT};
    if (fileExists(mFile))
        return {};
    auto bytes = emptyRegistry();
    if (!bytes)
        return bytes.failure();
    if (!isOnNetwork(mFile.parent_path().string()))
        bytes->replace(kJournalKind, kJournalKindBytes, kJournalKindBytes, '\2');
    const auto made = makeFileOnce(mFile, *bytes);
    return made ? made : Failure{L"it cannot be made: " + made.sentence()};
}

Result<> Registry::connect(const std::string& name, int flags)
{
    close();
    int status = sqlite3_open_v2(name.c_str(), &mDatabase, flags | SQLITE_OPEN_NOMUTEX, nullptr);
    if (status == SQLITE_OK)
        status = sqlite3_busy_timeout(mDatabase, static_cast<int>(mBusyTimeout.count()));
    if (status == SQLITE_OK)
        status = makeSafe(mDatabase);
    return status == SQLITE_OK ? Result<>() : storeFailure(mDatabase, status);
}

Result<> Registry::openFile()
{
    const auto foreign = setForeignLogAside(mFile);
    if (!foreign)
        return foreign.failure();
    mNotice = *foreign;
    const int flags = mReadOnly ? SQLITE_OPEN_READONLY : SQLITE_OPEN_READWRITE | SQLITE_OPEN_CREATE;
    auto opened = connect(mFile.string(), flags);
    if (!opened)
        return opened;
    mReadOnly = sqlite3_db_readonly(mDatabase, "main") == 1;
    if (!mReadOnly && isOnNetwork(mFile.parent_path().string()) && checkOrigin())
        leaveSharedLog(); // of a file that is ours to change
    const auto asked = firstNumber(mDatabase, kAskVersion);
    return asked || !isRefusal(asked.code()) ? Result<>() : openWithoutJournal(asked.failure());
}

// A profile that was moved to the network has its file's journal changed by the first session there. Of
// several at once each stands in the way of the others, and lets go for a moment. What comes of it
// `chooseJournal` sees.
void Registry::leaveSharedLog()
{
    constexpr std::chrono::milliseconds kPause{20};
    std::random_device random;
    const auto end = std::chrono::steady_clock::now() + mBusyTimeout;
    while (firstText(mDatabase, kUseJournal).code() == SQLITE_BUSY && std::chrono::steady_clock::now() < end)
    {
        close();
        std::this_thread::sleep_for(kPause * (1 + random() % 5));
        if (!connect(mFile.string(), SQLITE_OPEN_READWRITE))
            return;
        sqlite3_busy_timeout(mDatabase, 0);
    }
    sqlite3_busy_timeout(mDatabase, static_cast<int>(mBusyTimeout.count()));
}

// Where the journal's files cannot be made, what is stored can be read all the same.
Result<> Registry::openWithoutJournal(const Failure& reason)
{
    if (!mReadOnly)
        mCanStore = Failure{L"Nothing can be stored in the registry " + toWide(mFile.string()) + L": " +
                                reason.sentence + L". What is stored there is used.",
                            ERROR_ACCESS_DENIED};
    if (!holdsSomething(mFile.string() + "-wal"))
        return connect(asFixedFile(mFile), SQLITE_OPEN_READONLY | SQLITE_OPEN_URI);
    // Alone with the file, the store keeps in memory what tells the log's pages.
    auto alone = connect(mFile.string(), mReadOnly ? SQLITE_OPEN_READONLY : SQLITE_OPEN_READWRITE);
    if (alone &&
        sqlite3_exec(mDatabase, "PRAGMA locking_mode=EXCLUSIVE", nullptr, nullptr, nullptr) == SQLITE_OK)
        alone = readIntoMemory();
    return alone ? alone : Result<>(reason);
}

// Handles too: the keys of another file have other numbers.
void Registry::forgetAll()
{
    if (mDatabase)
        rollBack();
    mCursor = {};
    mHandles.clear();
    mOpenedForWriting.clear();
    mDamaged = false;
    mLookedAt = false;
}

// What can be read is copied and used from then on; the file is let go.
Result<> Registry::readIntoMemory()
{
    sqlite3_int64 size = 0;
    unsigned char* image = sqlite3_serialize(mDatabase, "main", &size, 0);
    if (!image)
        return storeFailure(mDatabase, sqlite3_errcode(mDatabase));
    if (static_cast<std::size_t>(size) > kJournalKind + kJournalKindBytes)
        std::memset(image + kJournalKind, 1, kJournalKindBytes);
    if (auto opened = connect(":memory:", SQLITE_OPEN_READWRITE); !opened)
    {
        sqlite3_free(image);
        return opened;
    }
    constexpr unsigned kFlags = SQLITE_DESERIALIZE_FREEONCLOSE | SQLITE_DESERIALIZE_RESIZEABLE;
    const int status = sqlite3_deserialize(mDatabase, "main", image, size, size, kFlags);
    return status == SQLITE_OK ? Result<>() : storeFailure(mDatabase, status);
}

// Whether the file is a registry that this host understands. Answers its version, 0 for a new one.
Result<int> Registry::checkOrigin()
{
    const auto asked = firstNumber(mDatabase, kAskVersion);
    if (!asked)
        return asked.failure();
    const int version = static_cast<int>(*asked);
    if (version > kSchemaVersion)
        return Failure{L"it was written by a newer Tessel"};
    if (version >= kVersionWithoutChecksums)
    {
        const auto known = checkTables(mDatabase, version);
        return known ? Result<int>(version) : known.failure();
    }
    const auto tables = firstNumber(mDatabase, "SELECT count(*) FROM sqlite_master");
    if (!tables)
        return tables.failure();
    return *tables == 0 ? Result<int>(version) : Failure{L"it belongs to another program"};
}

// What is somebody else's is recognised before anything is written: the journal's kind is part of the file.
Result<> Registry::prepare()
{
    auto version = checkOrigin();
    // Another process may have changed the tables between two looks; then it says its version by now.
    if (!version)
        version = checkOrigin();
    if (!version)
        return version.failure();
    constexpr const char* kManners =
        "PRAGMA synchronous=FULL; PRAGMA foreign_keys=ON; PRAGMA cell_size_check=ON";
    if (const int status = sqlite3_exec(mDatabase, kManners, nullptr, nullptr, nullptr); status != SQLITE_OK)
        return storeFailure(mDatabase, status);
    lookAtAll(*version);
    if (auto current = bringUpToDate(*version); !current)
        return current;
    if (auto prepared = prepareStatements(); !prepared)
        return prepared;
    const auto journal = mReadOnly || !mCanStore ? Result<>() : chooseJournal();
    if (journal)
        renewCopy(*version != kSchemaVersion);
    return journal;
}

LongStatements Registry::whileIt(const std::wstring& deed)
{
    return {mDatabase, mWork,
            L"Tessel " + deed + L" the registry " + toWide(mFile.string()) + L", which takes its time."};
}

// Damage is told at once. What is sound among it is read, each row on its own account.
void Registry::lookAtAll(int version)
{
    std::random_device random;
    const bool old = version < kSchemaVersion;
    if (!old && !mLeftOpen && random() % startsBetweenLooks(mDatabase) != 0)
        return;
    const LongStatements looking = whileIt(L"looks through");
    const auto sound = checkSoundness(mDatabase, version);
    mLookedAt = static_cast<bool>(sound);
    if (!sound)
        mCanStore = damage(sound.sentence());
}

Failure Registry::damage(const std::wstring& reason)
{
    mDamaged = true;
    return {L"The registry " + toWide(mFile.string()) + L" is damaged: " + reason +
                L". It was left as it is, and nothing will be stored. " + helpAgainstDamage(mFile),
            ERROR_ACCESS_DENIED};
}

// An older file that cannot be changed is read as if it had been.
Result<> Registry::bringUpToDate(int version)
{
    if (version == kSchemaVersion)
        return {};
    if (version == 0)
        return mReadOnly ? Failure{L"it is empty and may not be written"} : makeTables(mDatabase);
    if (!mReadOnly && mCanStore)
    {
        const LongStatements changing = whileIt(L"brings up to date");
        const auto changed = addChecksums(mDatabase);
        if (changed)
            return changed;
        mCanStore = Failure{L"Nothing can be stored in the registry " + toWide(mFile.string()) +
                                L", which an older Tessel has written: " + changed.sentence() +
                                L". What is stored there is used.",
                            ERROR_ACCESS_DENIED};
    }
    const auto read = readIntoMemory();
    return read ? addChecksums(mDatabase) : read;
}

Result<> Registry::prepareStatements()
{
    const auto number = firstNumber(mDatabase, "PRAGMA application_id");
    if (!number)
        return number.failure();
    mStatements = std::make_unique<Statements>();
    const int status = mStatements->prepare(mDatabase, *number);
    return status == SQLITE_OK ? Result<>() : storeFailure(mDatabase, status);
}

// A write-ahead log needs memory that all sessions share, which those on two machines do not.
Result<> Registry::chooseJournal()
{
    const bool network = isOnNetwork(mFile.parent_path().string());
    const auto kind = firstText(mDatabase, network ? kUseJournal : kUseLog);
    if (network && (!kind || *kind != L"delete"))
        return Failure{
            L"it lies in a folder of the network, and another session has it open as if it did not"};
    // Another process is about to change the journal's kind; until then the old one keeps the promises too.
    return kind || kind.code() == SQLITE_BUSY ? Result<>() : kind.failure();
}

// A session that ended in good order has made its copy; one that did not has left the file newer than that.
void Registry::renewCopy(bool changed)
{
    if (!mLookedAt || !mCanStore || mReadOnly)
        return;
    const auto copy = soundCopyOf(mFile);
    mHasStored =
        changed ||
        (mLeftOpen && (!fileExists(copy) || isNewer(mFile, copy) || isNewer(mFile.string() + "-wal", copy)));
    static_cast<void>(keepCopy()); // the session's end makes it, and tells
}

Result<> Registry::keepCopy()
{
    if (!mDatabase || !mCanStore || !mLookedAt || !mHasStored)
        return {};
    const auto made = makeSoundCopy(mDatabase, mFile);
    mHasStored = !made;
    return made ? made
                : Failure{L"The copy of the registry " + toWide(mFile.string()) + L" could not be made: " +
                          made.sentence() + L"."};
}

Result<std::wstring> Registry::restoreCopy()
{
    if (!mDamaged)
        return Failure{L"The registry " + toWide(mFile.string()) +
                       L" is not known to be damaged; it was left as it is."};
    const std::wstring time = timeOfCopy(mFile);
    forgetAll();
    close();
    const auto kept = putSoundCopyBack(mFile);
    mCanStore = {};
    open();
    if (!kept)
        return kept.failure();
    mCanStore = Failure{L"Nothing is stored in the registry " + toWide(mFile.string()) +
                            L" before Tessel is started again, since it was restored.",
                        ERROR_ACCESS_DENIED};
    return L"The registry " + toWide(mFile.string()) + L" was restored from the copy of " + time +
           (kept->empty() ? L"" : L"; what stood there is kept as " + toWide(kept->string())) +
           L". Start Tessel again: this session stores nothing more.";
}
} // namespace tessel
