// Opening the registry's file: whose it is, whether it is sound, and whether it may be written.
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <chrono>
#include <cstring>
#include <random>

#include "host/platform/NetworkFolder.h"
#include "host/platform/OrdinaryFile.h"
#include "host/registry/CopyElsewhere.h"
#include "host/registry/Journals.h"
#include "host/registry/LongStatements.h"
#include "host/registry/Schema.h"
#include "host/registry/SoundCopy.h"
#include "host/registry/Soundness.h"
#include "host/registry/Statements.h"
#include "host/registry/StoreFailure.h"
#include "host/text/Translation.h"

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

bool isMissing(int error)
{
    return error == ENOENT || error == ENOTDIR;
}

// Where the system cannot say, it does.
bool holdsSomething(const std::filesystem::path& file)
{
    struct stat status = {};
    if (stat(file.c_str(), &status) != 0)
        return !isMissing(errno);
    return !S_ISREG(status.st_mode) || status.st_size > 0;
}

// Opening what is no file at all would fail in words that do not say so, or wait. What cannot be asked for is
// not taken for missing.
Result<> checkKind(const std::filesystem::path& file)
{
    struct stat status = {};
    if (stat(file.c_str(), &status) != 0)
        return isMissing(errno) ? Result<>() : fileFailure(errno);
    const auto ordinary = checkOrdinary(status);
    return ordinary ? ordinary : Failure{ordinary.sentence(), SQLITE_NOTADB};
}

// The store takes a folder for a journal that it may not write.
Result<> checkPlacesOfJournals(const std::filesystem::path& file)
{
    for (const auto& journal : {logOf(file), indexOfLog(file), rollbackJournalOf(file)})
        if (const auto ordinary = checkKind(journal); ordinary.code() == SQLITE_NOTADB)
            return Failure{translated(L"what stands at {} is in its way: {}", journal, ordinary.sentence()),
                           kInTheWay};
    return {};
}

// Of a journal that it cannot make the store says that there is none, and of a right that is missing not to
// what.
Failure whyRefused(const std::filesystem::path& file, const Failure& failure)
{
    const bool isUnclear = failure.code == SQLITE_CANTOPEN || failure.code == SQLITE_PERM;
    if (isUnclear && access(file.parent_path().c_str(), W_OK) != 0)
        return {translated(L"its folder may not be written"), SQLITE_PERM};
    return failure;
}

bool fileExists(const std::filesystem::path& file)
{
    std::error_code missing;
    return std::filesystem::exists(file, missing);
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
        mCanStore = Failure{translated(L"The registry {} may only be read: what is stored there is used, and "
                                       L"nothing new will be stored.",
                                       mFile),
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
    close();
    mDamaged = isDamage(reason.code());
    const std::wstring help = whatHelps(reason.code());
    mCanStore = Failure{
        fileExists(mFile)
            ? translated(
                  L"The registry {} cannot be used: {}. It was left as it is, and nothing will be stored. {}",
                  mFile, reason.sentence(), help)
            : translated(L"The registry {} cannot be used: {}. Nothing will be stored. {}", mFile,
                         reason.sentence(), help),
        ERROR_ACCESS_DENIED};
}

// What is there is read.
void Registry::storeNothing(const Failure& reason)
{
    mCanStore =
        Failure{translated(L"Nothing can be stored in the registry {}: {}. What is stored there is used. {}",
                           mFile, reason.sentence, whatHelpsAtStart(reason.code)),
                ERROR_ACCESS_DENIED};
}

// A new file appears with all that it needs: of many first starts none sees half of it. One that was there
// once is not made again, for then its copy would be the next to go.
Result<> Registry::makeMissingFile()
{
    const bool hasCopy = holdsSomething(soundCopyOf(mFile));
    if (holdsSomething(mFile))
        return {};
    if (hasCopy)
        return Failure{translated(L"it is empty or missing, but the copy of what it held is there"),
                       SQLITE_CORRUPT};
    if (fileExists(mFile))
        return {};
    auto bytes = emptyRegistry();
    if (!bytes)
        return bytes.failure();
    if (!isOnNetwork(mFile.parent_path().string()))
        bytes->replace(kJournalKind, kJournalKindBytes, kJournalKindBytes, '\2');
    const auto made = makeFileOnce(mFile, *bytes);
    return made ? made : Failure{translated(L"it cannot be made: {}", made.sentence()), SQLITE_CANTOPEN};
}

Result<> Registry::connect(const std::string& name, int flags)
{
    close();
    int status = sqlite3_open_v2(name.c_str(), &mDatabase, flags | SQLITE_OPEN_NOMUTEX, nullptr);
    if (status == SQLITE_OK)
        status = mWait.attach(mDatabase);
    if (status == SQLITE_OK)
        status = makeSafe(mDatabase);
    return status == SQLITE_OK ? Result<>() : storeFailure(mDatabase, status);
}

Result<> Registry::openFile()
{
    const auto foreign = setForeignLogAside(mFile);
    if (!foreign)
        return openFixed(foreign.failure());
    mNotice = *foreign;
    if (const auto clear = checkPlacesOfJournals(mFile); !clear)
        return openWithoutJournal(clear.failure());
    const int flags = mReadOnly ? SQLITE_OPEN_READONLY : SQLITE_OPEN_READWRITE | SQLITE_OPEN_CREATE;
    auto opened = connect(mFile.string(), flags);
    if (!opened)
        return opened;
    mReadOnly = sqlite3_db_readonly(mDatabase, "main") == 1;
    if (!mReadOnly && isOnNetwork(mFile.parent_path().string()) && checkOrigin())
        leaveSharedLog(); // of a file that is ours to change
    const auto asked = firstNumber(mDatabase, kAskVersion);
    if (asked.code() == SQLITE_BUSY)
        return readPastLock(asked.failure());
    return asked || !isRefusal(asked.code()) ? Result<>()
                                             : openWithoutJournal(whyRefused(mFile, asked.failure()));
}

// A profile that was moved to the network has its file's journal changed by the first session there. Of
// several at once each stands in the way of the others, and lets go for a moment. What comes of it
// `chooseJournal` sees.
void Registry::leaveSharedLog()
{
    constexpr std::chrono::milliseconds kPause{20};
    std::random_device random;
    while (firstText(mDatabase, kUseJournal).code() == SQLITE_BUSY)
    {
        close();
        const bool isPatient = mWait.pause(kPause * (1 + random() % 5));
        if (!connect(mFile.string(), SQLITE_OPEN_READWRITE) || !isPatient)
            return;
        LockWait::detach(mDatabase);
    }
    mWait.attach(mDatabase);
}

// Where the journal's files cannot be made, what is stored can be read all the same.
Result<> Registry::openWithoutJournal(const Failure& reason)
{
    if (!isInUse(logOf(mFile)) && !isInUse(rollbackJournalOf(mFile)))
        return openFixed(reason);
    if (!mReadOnly)
        storeNothing(reason);
    const auto alone = openAlone();
    return alone ? alone : readElsewhere(reason);
}

// Alone with the file, the store keeps in memory what tells the log's pages.
Result<> Registry::openAlone()
{
    const auto opened = connect(mFile.string(), mReadOnly ? SQLITE_OPEN_READONLY : SQLITE_OPEN_READWRITE);
    if (!opened)
        return opened;
    const int status = sqlite3_exec(mDatabase, "PRAGMA locking_mode=EXCLUSIVE", nullptr, nullptr, nullptr);
    return status == SQLITE_OK ? readIntoMemory() : Result<>(storeFailure(mDatabase, status));
}

// Whose journal cannot be brought together with it, or whose lock is not given.
Result<> Registry::readElsewhere(const Failure& reason)
{
    close();
    const CopyElsewhere copy(mFile);
    if (!copy.made())
        return reason;
    auto read = connect(copy.file().string(), SQLITE_OPEN_READWRITE);
    if (read)
        read = readIntoMemory();
    return read ? read : Result<>(reason);
}

Result<> Registry::openFixed(const Failure& reason)
{
    if (!mReadOnly)
        storeNothing(reason);
    return connect(asFixedFile(mFile), SQLITE_OPEN_READONLY | SQLITE_OPEN_URI);
}

// What another program has not stored yet stands in its journal, or in what it holds in memory: a copy is
// what was stored before. One that it has changed meanwhile may be half of this and half of that.
Result<> Registry::readPastLock(const Failure& reason)
{
    storeNothing(reason);
    if (const auto read = readElsewhere(reason); !read)
        return read;
    const auto version = checkOrigin();
    return version && checkSoundness(mDatabase, *version) ? Result<>() : Result<>(reason);
}

// Handles too: the keys of another file have other numbers.
void Registry::forgetAll()
{
    if (mDatabase)
        rollBack();
    mCursor = {};
    mHandles.clear();
    mNewestHandle = {};
    mOpenedForWriting.clear();
    mDamaged = false;
    mUnreadable = false;
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
    if (version != kSchemaVersion && version != kVersionWithoutChecksums)
        return checkUnknown(version);
    const auto known = checkTables(mDatabase, version);
    return known ? Result<int>(version) : known.failure();
}

// A registry whose version is damaged still has the tables of one. A copy that stands beside a file of
// somebody else shows that a registry was there.
Result<int> Registry::checkUnknown(int version)
{
    const bool isOurs =
        checkTables(mDatabase, kSchemaVersion) || checkTables(mDatabase, kVersionWithoutChecksums);
    const bool hasCopy = fileExists(soundCopyOf(mFile));
    if (version > kSchemaVersion)
        return isOurs && hasCopy
                   ? Failure{translated(L"it was written by a newer Tessel, or its version is damaged"),
                             SQLITE_CORRUPT}
                   : Failure{translated(L"it was written by a newer Tessel"), kOfANewerTessel};
    if (isOurs)
        return Failure{translated(L"its version is damaged"), SQLITE_CORRUPT};
    const auto tables = firstNumber(mDatabase, "SELECT count(*) FROM sqlite_master");
    if (!tables)
        return tables.failure();
    if (version == 0 && *tables == 0)
        return version;
    return Failure{translated(L"it belongs to another program"), hasCopy ? SQLITE_NOTADB : kOfAnotherProgram};
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

LongStatements Registry::whileTelling(const std::wstring& sentence, bool canBeStopped)
{
    if (!canBeStopped)
        return {mDatabase, mWork, sentence, {}};
    return {mDatabase, mWork, sentence + L" " + translated(L"Ctrl-C ends that."),
            [this]
            {
                return mWait.isUnwanted();
            }};
}

// Damage is told at once. What is sound among it is read, each row on its own account. A person need not
// wait: the first removal looks again.
void Registry::lookAtAll(int version)
{
    std::random_device random;
    const bool old = version < kSchemaVersion;
    if (!old && !mLeftOpen && random() % startsBetweenLooks(mDatabase) != 0)
        return;
    const LongStatements looking =
        whileTelling(translated(L"Tessel looks through the registry {}, which takes its time.", mFile), true);
    const auto sound = checkSoundness(mDatabase, version);
    mLookedAt = static_cast<bool>(sound);
    if (sound.code() == SQLITE_INTERRUPT)
        mWork.say(translated(L"The registry {} was not looked through to its end. That is done before "
                             L"anything is removed from it.",
                             mFile));
    else if (!sound)
        mCanStore = whatIsWrong(sound.failure());
}

// An older file that cannot be changed is read as if it had been.
Result<> Registry::bringUpToDate(int version)
{
    if (version == kSchemaVersion)
        return {};
    if (version == 0)
        return mReadOnly ? Failure{translated(L"it is empty and may not be written")} : makeTables(mDatabase);
    if (!mReadOnly && mCanStore)
    {
        const LongStatements changing = whileTelling(
            translated(L"Tessel brings up to date the registry {}, which takes its time.", mFile), false);
        const auto changed = addChecksums(mDatabase);
        if (changed)
            return changed;
        storeNothing(changed.failure());
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
        return Failure{translated(
            L"it lies in a folder of the network, and another session has it open as if it did not")};
    if (kind || !isRefusal(kind.code()))
        // Another process is about to change the journal's kind; until then the old one keeps the promises
        // too.
        return kind || kind.code() == SQLITE_BUSY ? Result<>() : kind.failure();
    storeNothing(kind.failure());
    return {};
}
} // namespace tessel
