#include "host/registry/Registry.h"
#include "host/registry/KeyPath.h"

#include <sqlite3.h>

#include <algorithm>
#include <utility>

#include "host/registry/LongStatements.h"
#include "host/registry/Schema.h"
#include "host/registry/SoundCopy.h"
#include "host/registry/Soundness.h"
#include "host/registry/Statements.h"
#include "host/registry/StoreFailure.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr std::uintptr_t kFirstHandle = 0x1000;
// Written pages are handed to the file system after each of the first writes of a command and every so often
// later, so that a full disk shows at the write that it hits and the caller can tell its user.
constexpr unsigned kWritesFlushedAtOnce = 64;

// Columns of what the statements find, after the row's number and whether it is what was stored.
constexpr int kThird = 2;
constexpr int kFourth = 3;

// The store has tried for ten seconds, and would for every row.
bool isLockRefused(int status)
{
    return status == SQLITE_PROTOCOL;
}

Failure noSuchValue()
{
    return {translated(L"There is no such value."), ERROR_FILE_NOT_FOUND};
}

Failure noMoreValues()
{
    return {translated(L"There are no more values."), ERROR_NO_MORE_ITEMS};
}
} // namespace

Registry::Registry(std::filesystem::path file, std::chrono::milliseconds busyTimeout, LongWork::Say say,
                   LockWait::IsUnwanted isUnwanted)
    : mFile(std::move(file)),
      mWait(busyTimeout,
            [this](bool canBeStopped)
            {
                mWork.say(canBeStopped
                              ? translated(L"Tessel waits for the registry {}, which another program holds. "
                                           L"Ctrl-C goes on without it.",
                                           mFile)
                              : translated(L"Tessel waits for the registry {}, which another program holds.",
                                           mFile));
            }),
      mNextHandle(kFirstHandle)
{
    mWork.tellBy(std::move(say));
    mWait.letStop(std::move(isUnwanted));
    open();
    mWait.letStop({}); // what a session stores at its end is waited for
}

Registry::~Registry()
{
    static_cast<void>(endOfCommand()); // who wants to know whether it was stored has asked before
    close();
}

Registry::Key Registry::findChild(Key parent, std::wstring_view name)
{
    Statement& find = mStatements->findKey;
    if (step(find.bind(parent).bindUtf8(foldedUtf8(name))) != SQLITE_ROW)
        return kNoKey;
    const Key key = find.number(0);
    find.reset();
    return key;
}

bool Registry::isFollowed(std::wstring_view path, Key from) const
{
    return mFollowed.key != kNoKey && mFollowed.from == from && mFollowed.path == path;
}

// Within a transaction nobody else's changes are seen, and keys are not removed unnoticed.
void Registry::noteFollowed(std::wstring_view path, Key from, Key key)
{
    if (sqlite3_get_autocommit(mDatabase) == 0)
        mFollowed = {from, std::wstring(path), key};
}

Registry::Key Registry::find(std::wstring_view path, Key from)
{
    if (!mDatabase)
        return kNoKey;
    beginReading();
    if (isFollowed(path, from))
        return mFollowed.key;
    Key key = from;
    for (std::wstring_view rest = path; !rest.empty() && key != kNoKey;)
    {
        const std::wstring_view part = takeKeyPart(rest);
        if (!part.empty())
            key = findChild(key, part);
    }
    noteFollowed(path, from, key);
    return key;
}

Result<Registry::Key> Registry::createChild(Key parent, std::wstring_view name)
{
    if (const auto writing = beginWriting(); !writing)
        return writing.failure();
    // Another process may have made it before the transaction began.
    if (const Key found = findChild(parent, name); found != kNoKey)
        return found;
    const int status = mStatements->insertKey.bind(parent).bind(name).bindUtf8(foldedUtf8(name)).run();
    const Key made = sqlite3_last_insert_rowid(mDatabase);
    const auto written = finishWrite(status);
    return written ? Result<Key>(made) : written.failure();
}

Result<Registry::Key> Registry::create(std::wstring_view path, Key from)
{
    // Opening an existing key is no write, but who opens it this way is about to write.
    if (!mCanStore)
        return mCanStore.failure();
    auto made = isFollowed(path, from) ? Result<Key>(mFollowed.key) : makePath(path, from);
    if (made)
        mOpenedForWriting.insert(*made);
    return made;
}

Result<Registry::Key> Registry::makePath(std::wstring_view path, Key from)
{
    Key key = from;
    for (std::wstring_view rest = path; !rest.empty();)
    {
        const std::wstring_view part = takeKeyPart(rest);
        if (part.empty())
            continue;
        const Key found = findChild(key, part);
        auto child = found != kNoKey ? Result<Key>(found) : createChild(key, part);
        if (!child)
            return child;
        key = *child;
    }
    noteFollowed(path, from, key);
    return key;
}

std::vector<std::wstring> Registry::subKeys(Key key)
{
    std::vector<std::wstring> names;
    if (!mDatabase)
        return names;
    beginReading();
    Statement& list = mStatements->subKeys;
    list.bind(key);
    for (std::int64_t last = 0; isNext(list, last);)
        names.push_back(list.text(kThird));
    return names;
}

Result<> Registry::removeKey(Key key)
{
    if (key == kNoKey || key == kRoot)
        return Failure{translated(L"Only a key below the root can be removed."), ERROR_INVALID_PARAMETER};
    if (auto writing = beginWriting(); !writing)
        return writing;
    if (auto sound = checkBeforeRemoval(); !sound)
        return sound;
    if (auto settled = settle(); !settled)
        return settled;
    mCursor = {};
    mFollowed = {};
    return finishWrite(mStatements->deleteKey.bind(key).run());
}

Result<std::wstring> Registry::readValue(Key key, std::wstring_view name)
{
    if (!mDatabase)
        return noSuchValue();
    lookInto(key);
    mWork.count();
    std::string fold = foldedUtf8(name);
    int status = readAhead(key, fold);
    if (status == SQLITE_ROW)
        return toWide(mReadAhead.data());
    Statement& read = mStatements->readValue;
    if (status == SQLITE_DONE)
        status = step(read.bind(key).bindUtf8(std::move(fold)));
    if (status != SQLITE_ROW)
        return status == SQLITE_DONE
                   ? noSuchValue()
                   : Failure{(mCommand ? mCanStore : mCommand).sentence(), ERROR_READ_FAULT};
    mReadAhead.noteFound(key, read.number(0));
    std::wstring data = read.text(kThird);
    read.reset();
    return data;
}

// SQLITE_ROW: the value is that of the row after the one that was read last, on which `followingValues`
// stands. SQLITE_DONE: it has to be searched.
int Registry::readAhead(Key key, std::string_view fold)
{
    if (mCannotLock || mWork.isInterrupted())
        return SQLITE_DONE;
    const int status = mReadAhead.step(mStatements->followingValues, key, fold);
    if (status != SQLITE_ROW && status != SQLITE_DONE)
        failStep(status);
    return status;
}

Result<> Registry::writeValue(Key key, std::wstring_view name, std::wstring_view data)
{
    if (auto writing = beginWriting(); !writing)
        return writing;
    std::string utf8Name = toUtf8(name);
    std::string fold = foldedUtf8(name);
    std::string utf8Data = toUtf8(data);
    if (mStatements->removed.areOf(key))
    {
        const int status = mStatements->removed.write(key, utf8Name, fold, utf8Data);
        if (status != SQLITE_NOTFOUND)
            return finishWrite(status);
        if (auto settled = settle(); !settled)
            return settled;
    }
    NewRows& added = mStatements->added;
    added.add(key, std::move(utf8Name), std::move(fold), std::move(utf8Data));
    const bool waits = mWrites >= kWritesFlushedAtOnce && !added.isFull();
    return finishWrite(waits ? SQLITE_DONE : added.store());
}

Result<> Registry::removeValue(Key key, std::wstring_view name)
{
    if (auto writing = beginWriting(); !writing)
        return writing;
    if (auto sound = checkBeforeRemoval(); !sound)
        return sound;
    mCursor = {};
    std::string fold = foldedUtf8(name);
    if (auto stored = storeAdded(); !stored)
        return stored;
    if (mStatements->removed.remove(key, fold))
        return {};
    if (auto settled = settle(); !settled)
        return settled;
    auto removed = finishWrite(mStatements->deleteValue.bind(key).bindUtf8(std::move(fold)).run());
    if (removed && sqlite3_changes(mDatabase) == 0)
        return noSuchValue();
    return removed;
}

Result<std::wstring> Registry::valueName(Key key, DWORD index)
{
    if (!mDatabase)
        return noMoreValues();
    lookInto(key);
    const bool next = mCursor.key == key && index == mCursor.index + 1;
    Statement& find = next || index == 0 ? mStatements->nextValues : mStatements->valueAt;
    std::int64_t sequence = next ? mCursor.sequence : 0;
    if (!next || !find.isStanding())
    {
        mStatements->nextValues.reset();
        find.bind(key).bind(next ? mCursor.sequence : std::int64_t{index});
    }
    // A store that cannot be read has no more items either: whoever walks it must come to an end.
    if (!isNext(find, sequence))
        return noMoreValues();
    mCursor = {key, index, sequence};
    std::wstring name = find.text(kThird);
    if (&find == &mStatements->valueAt)
        find.reset(); // the other one stands there for the next index
    return name;
}

std::vector<Registry::Value> Registry::values(Key key)
{
    std::vector<Value> found;
    if (!mDatabase)
        return found;
    lookInto(key);
    Statement& list = mStatements->values;
    list.bind(key);
    for (std::int64_t last = 0; isNext(list, last);)
        found.push_back({list.text(kThird), list.text(kFourth)});
    return found;
}

std::optional<std::wstring> Registry::read(std::wstring_view path, std::wstring_view name)
{
    const Key key = find(path);
    if (key == kNoKey)
        return std::nullopt;
    auto data = readValue(key, name);
    return data ? std::optional(*std::move(data)) : std::nullopt;
}

Result<> Registry::write(std::wstring_view path, std::wstring_view name, std::wstring_view data)
{
    const auto key = create(path, kRoot);
    return key ? writeValue(*key, name, data) : key.failure();
}

Result<> Registry::beginWriting()
{
    if (!mCanStore)
        return mCanStore;
    letGoOfRows();
    mWork.count();
    if (mCommand && mWork.isInterrupted())
        return fail(SQLITE_INTERRUPT);
    if (!mCommand || mWriting)
        return mCommand;
    // What was read by now is of a moment that may be over; the writes are to stand on what is stored now.
    commit();
    if (auto there = checkPlace(); !there)
        return there;
    mWrites = 0;
    int status = mStatements->begin.run();
    mWriting = status == SQLITE_DONE;
    if (mWriting)
        status = mStatements->mark.run();
    return status == SQLITE_DONE ? Result<>() : fail(status);
}

// What is written to a file that has lost its name is lost with it.
Result<> Registry::checkPlace()
{
    int moved = 0;
    sqlite3_file_control(mDatabase, "main", SQLITE_FCNTL_HAS_MOVED, &moved);
    if (moved == 0)
        return {};
    return giveUp({translated(L"Nothing more can be stored in the registry {} in this session: it was "
                              L"removed, or another file was put in its place. Start Tessel again.",
                              mFile),
                   ERROR_WRITE_FAULT});
}

// What a removal rests on was read, and damage may have left some of it out.
Result<> Registry::checkBeforeRemoval()
{
    if (mLookedAt)
        return {};
    const LongStatements looking = whileTelling(
        translated(L"Tessel looks through the registry {}, which takes its time.", mFile), false);
    const auto sound = checkSoundness(mDatabase, kSchemaVersion);
    mLookedAt = static_cast<bool>(sound);
    return sound ? sound : giveUp(whatIsWrong(sound.failure()));
}

// Where this fails, the reading that follows says so.
void Registry::beginReading()
{
    if (sqlite3_get_autocommit(mDatabase))
        static_cast<void>(mStatements->beginReading.run());
}

// What is seen in a key before it is written must still hold when it is. A lock that cannot be had makes the
// writes fail, not the look.
void Registry::lookInto(Key key)
{
    if (!mWriting && mOpenedForWriting.contains(key))
        static_cast<void>(beginWriting());
    static_cast<void>(settle()); // what fails is told by the next write, or at the command's end
    beginReading();
}

Result<> Registry::storeAdded()
{
    const int status = mStatements->added.store();
    return status == SQLITE_DONE ? Result<>() : fail(status);
}

// Everything that was written or removed stands in the file from then on.
Result<> Registry::settle()
{
    if (!mWriting)
        return {};
    if (auto stored = storeAdded(); !stored)
        return stored;
    const int status = mStatements->removed.settle();
    return status == SQLITE_DONE ? Result<>() : fail(status);
}

Result<> Registry::finishWrite(int status)
{
    if (status != SQLITE_DONE)
        return fail(status);
    ++mWrites;
    if (mWrites > kWritesFlushedAtOnce && mWrites % kWritesFlushedAtOnce != 0)
        return {};
    status = sqlite3_db_cacheflush(mDatabase);
    // Pages in use are flushed another time.
    return status == SQLITE_OK || status == SQLITE_BUSY ? Result<>() : fail(status);
}

// What could not be read must not be mistaken for what is not there and then be overwritten. The command's
// end tells it. Every row says in its second column whether it is what was stored; one that is not is no row.
int Registry::step(Statement& statement)
{
    int status = mCannotLock ? SQLITE_PROTOCOL : SQLITE_INTERRUPT;
    if (mCannotLock || mWork.isInterrupted())
        statement.reset();
    else
        status = statement.step();
    if (status == SQLITE_DONE || (status == SQLITE_ROW && statement.number(1) == 1))
        return status;
    if (status != SQLITE_ROW)
    {
        failStep(status);
        return status;
    }
    statement.reset();
    failRead(translated(L"a row of it is not what was stored there"), SQLITE_CORRUPT);
    return SQLITE_CORRUPT;
}

void Registry::failStep(int status)
{
    mCannotLock = isLockRefused(status);
    const Failure failure = storeFailure(mDatabase, status);
    failRead(failure.sentence, failure.code);
}

// Of rows that come in the order of their first column, which only an index that is damaged does not keep: it
// could lead round and round.
bool Registry::isNext(Statement& statement, std::int64_t& last)
{
    mWork.count();
    if (step(statement) != SQLITE_ROW)
        return false;
    if (const std::int64_t number = statement.number(0); number > last)
    {
        last = number;
        return true;
    }
    statement.reset();
    failRead(translated(L"an index of it is out of order"), SQLITE_CORRUPT);
    return false;
}

// Nothing is written any more: who asked knows less than is stored, and will know no more. Damage is told
// once, by what finds it first.
void Registry::failRead(const std::wstring& words, int code)
{
    mLookedAt = false;
    mReadFailed = true;
    const bool isKnown = isDamage(code) ? std::exchange(mDamaged, true) : !mCommand && !mCanStore;
    if (isKnown)
    {
        undoCommand();
        return;
    }
    const Failure failure = unreadable({words, code});
    if (isDamage(code))
        mCanStore = failure; // whatever else there is to say of it
    static_cast<void>(giveUp(failure));
}

Failure Registry::unreadable(const Failure& found)
{
    return {translated(L"The registry {} could not be read: {}. Nothing more is stored in this session, so "
                       L"that nothing is lost. {}",
                       mFile, found.sentence, whatHelps(found.code)),
            ERROR_READ_FAULT};
}

// For the rest of the session. The command that it happens in tells it, unless it has failed before.
Failure Registry::giveUp(Failure failure)
{
    if (mCanStore)
        mCanStore = failure;
    if (mCommand)
        mCommand = std::move(failure);
    undoCommand();
    return mCommand.failure();
}

// Undoes the command at once: until it ends it reads what was stored before, and not what half a command
// left.
Failure Registry::fail(int status)
{
    if (!mCommand)
    {
        rollBack();
        return mCommand.failure();
    }
    const Failure reason = storeFailure(mDatabase, status);
    const std::wstring help = whatHelpsInSession(reason.code);
    mCommand =
        Failure{translated(L"The registry {} could not be written: {}. What was stored before is unchanged.",
                           mFile, reason.sentence) +
                    (help.empty() ? L"" : L" " + help),
                statusOf(reason.code)};
    undoCommand();
    return mCommand.failure();
}

void Registry::undoCommand()
{
    rollBack();
    mCursor = {};
    closeHandlesOfLostKeys();
}

// The store ends no transaction while a statement stands in it, and flushes no page that one stands on.
void Registry::letGoOfRows()
{
    mReadAhead.forget(mStatements->followingValues);
    if (mStatements->nextValues.isStanding())
        mStatements->nextValues.reset();
}

void Registry::forgetTransaction()
{
    letGoOfRows();
    mFollowed = {};
}

void Registry::rollBack()
{
    forgetTransaction();
    mStatements->added.forget();
    mStatements->removed.forget();
    // SQLite may have rolled back by itself already.
    if (!sqlite3_get_autocommit(mDatabase))
        mStatements->rollback.run();
    mWriting = false;
}

// The number of a key that was undone is given away again: a handle must not follow it to another key.
void Registry::closeHandlesOfLostKeys()
{
    const auto isLost = [this](Key key)
    {
        Statement& find = mStatements->keyExists;
        const bool lost = find.bind(key).step() == SQLITE_DONE;
        find.reset();
        return lost;
    };
    std::erase_if(mHandles, [&](const auto& handle) { return isLost(handle.second); });
    if (mNewestHandle.handle && isLost(mNewestHandle.key))
        mNewestHandle = {};
}

void Registry::commit()
{
    static_cast<void>(settle()); // what fails has undone the command, and its end tells it
    mStatements->removed.forget();
    forgetTransaction();
    if (sqlite3_get_autocommit(mDatabase))
        return;
    const int status = mStatements->commit.run();
    mHasStored = mHasStored || (mWriting && status == SQLITE_DONE);
    if (status != SQLITE_DONE)
        static_cast<void>(fail(status)); // the command's end tells it
    mWriting = false;
}

void Registry::storeSoFar()
{
    if (!mDatabase)
        return;
    commit();
    endOfWork();
}

Result<> Registry::store()
{
    storeSoFar();
    return mCommand;
}

void Registry::endOfWork()
{
    mWork.end();
    mWait.begin();
    mReadFailed = false;
}

Result<> Registry::endOfCommand()
{
    if (!mDatabase)
        return {};
    commit();
    endOfWork();
    mOpenedForWriting.clear();
    return std::exchange(mCommand, {});
}

std::wstring Registry::takeReason()
{
    const auto told = endOfCommand();
    return told ? mCanStore.sentence() : told.sentence();
}

// Most handles are closed before another one is opened: the newest stands alone, and costs no memory of its
// own.
HKEY Registry::openHandle(Key key)
{
    if (mNewestHandle.handle)
        mHandles.emplace(mNewestHandle.handle, mNewestHandle.key);
    mNewestHandle = {reinterpret_cast<HKEY>(mNextHandle++), key};
    return mNewestHandle.handle;
}

std::optional<Registry::Key> Registry::keyOf(HKEY handle) const
{
    if (handle == HKEY_CURRENT_USER)
        return kRoot;
    if (handle && handle == mNewestHandle.handle)
        return mNewestHandle.key;
    const auto found = mHandles.find(handle);
    return found == mHandles.end() ? std::nullopt : std::optional(found->second);
}

bool Registry::closeHandle(HKEY handle)
{
    if (handle && handle == mNewestHandle.handle)
    {
        mNewestHandle = {};
        return true;
    }
    return handle == HKEY_CURRENT_USER || mHandles.erase(handle) > 0;
}
} // namespace tessel
