// The registry: hierarchical keys with string values in one SQLite file per user.
//
// Names compare without regard to case (simple case folding) and keep the spelling they were created with;
// keys and values are enumerated in the order of creation. The first write of a command opens a transaction,
// or before that its first look into a key that it has opened for writing: what is to be replaced is listed
// inside. `endOfCommand` commits it, so that what a command stores is stored wholly or not at all, whatever
// happens to the process and whatever other processes write. What a command reads before it writes it reads
// as it stood at one moment, so that a list which is read value by value is one that somebody stored. Once
// the store could not be written or read, all that the command wrote is undone and the rest of its writes
// fail too.
//
// Each row carries a checksum, and the file is looked at as a whole when it is opened after a session that
// did not end in good order, or when that costs little, and at the latest before the first removal. Once
// anything could not be read, nothing is written until the registry is opened again: what an application
// knows may be less than what is stored. A copy of the last sound state stands beside the file.
//
// The codes of failures are those of the Windows-style registry calls (wincompat/wintypes.h).
#pragma once

#include <wincompat/winreg.h>

#include <chrono>
#include <cstdint>
#include <filesystem>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <unordered_set>
#include <utility>
#include <vector>

#include "host/registry/LockWait.h"
#include "host/registry/LongWork.h"
#include "host/registry/ReadAhead.h"
#include "host/text/Result.h"

struct sqlite3;

namespace tessel
{
class LongStatements;
class Statement;

class Registry
{
public:
    using Key = std::int64_t;
    static constexpr Key kNoKey = 0;
    static constexpr Key kRoot = 1; // HKEY_CURRENT_USER
    static constexpr std::chrono::milliseconds kBusyTimeout{5000};

    struct Value
    {
        std::wstring name; // empty: the key's unnamed value
        std::wstring data;
    };

    // Opens the file or makes it. A file that cannot be used is left as it is: reads then find nothing and
    // writes fail. A file that is damaged or may not be written is only read.
    // The opening waits that long for another process that holds the file, unless `isUnwanted` answers yes;
    // so does each command, which then fails. What takes long, the opening too, is told by `say`.
    explicit Registry(std::filesystem::path file, std::chrono::milliseconds busyTimeout = kBusyTimeout,
                      LongWork::Say say = {}, LockWait::IsUnwanted isUnwanted = {});
    ~Registry();
    Registry(const Registry&) = delete;
    Registry& operator=(const Registry&) = delete;

    // Whether anything can be stored; one sentence about why not.
    const Result<>& canStore() const { return mCanStore; }

    // What a person should know although the registry can be used: a sentence, mostly none.
    const std::optional<std::wstring>& notice() const { return mNotice; }

    // Paths are relative to `from`; the parts are separated by one backslash, empty parts are passed over.
    Key find(std::wstring_view path, Key from = kRoot);
    // Opens the key for writing, and makes it if need be. A key that is there already locks nobody out: it is
    // the way in which everybody makes sure of a key before reading below it.
    Result<Key> create(std::wstring_view path, Key from);
    std::vector<std::wstring> subKeys(Key key);
    // Removes the key, its values and everything below it.
    Result<> removeKey(Key key);

    Result<std::wstring> readValue(Key key, std::wstring_view name);
    Result<> writeValue(Key key, std::wstring_view name, std::wstring_view data);
    Result<> removeValue(Key key, std::wstring_view name);
    // The name of the value at an index from 0; cheap for indexes asked for in ascending order.
    Result<std::wstring> valueName(Key key, DWORD index);
    std::vector<Value> values(Key key);

    // What the running command did not find may be there all the same: something could not be read.
    bool mayHaveMissed() const { return !mDatabase || mDamaged || mReadFailed; }
    bool readFailed() const { return mReadFailed; }

    // Why something of the running command failed, or why nothing can be read or stored at all, in sentences
    // for a person. The command's writes are over, and its end does not tell it again.
    std::wstring takeReason();

    // The same by path, for the host's own settings.
    std::optional<std::wstring> read(std::wstring_view path, std::wstring_view name);
    Result<> write(std::wstring_view path, std::wstring_view name, std::wstring_view data);

    // Stores what the command wrote. When that or something before it failed, everything that the command
    // wrote is undone, and the sentence says so. Damage that `canStore` or an earlier command has told is not
    // told again.
    Result<> endOfCommand();

    // Stores what the command wrote so far, and reads as it stands from now on. A failure stays the
    // command's, and is told at its end.
    void storeSoFar();

    // The same, for who wants to know whether it is stored.
    Result<> store();

    // Makes the copy of the last sound state, if something was stored since the last one and the file is
    // known to be sound. A failure is a whole sentence.
    Result<> keepCopy();

    // Puts the copy in the place of a registry that is damaged, and reads it from now on. Answers a sentence
    // about it. Nothing can be stored before the next session: what applications have read is older.
    Result<std::wstring> restoreCopy();

    // Puts an empty registry in the place of one that is damaged and has no sound copy. The rest is as with
    // `restoreCopy`.
    Result<std::wstring> beginEmpty();

    // Stops reading or writing that takes long: what the command in which it happens reads from then on
    // fails, as from a store that cannot be read. Safe in a signal handler.
    void interrupt() noexcept { mWork.interrupt(); }

    // Handles for the registry calls. A handle that is not open is recognised, never followed.
    HKEY openHandle(Key key);
    std::optional<Key> keyOf(HKEY handle) const;
    bool closeHandle(HKEY handle);

private:
    struct Statements;
    // Where a path leads, for as long as the transaction lasts in which it was followed.
    struct Followed
    {
        Key from = kNoKey;
        std::wstring path;
        Key key = kNoKey;
    };
    struct Handle
    {
        HKEY handle = nullptr;
        Key key = kNoKey;
    };
    struct Cursor
    {
        Key key = kNoKey;
        DWORD index = 0;
        std::int64_t sequence = 0;
    };

    void open();
    void close();
    void refuse(const Result<>& reason);
    void forgetAll();
    Result<> makeMissingFile();
    Result<> openFile();
    Result<> connect(const std::string& name, int flags);
    void leaveSharedLog();
    Result<> openWithoutJournal(const Failure& reason);
    Result<> openAlone();
    Result<> readElsewhere(const Failure& reason);
    Result<> openFixed(const Failure& reason);
    Result<> readPastLock(const Failure& reason);
    Result<> readIntoMemory();
    void storeNothing(const Failure& reason);
    Result<int> checkOrigin();
    Result<int> checkUnknown(int version);
    Result<> prepare();
    Result<> bringUpToDate(int version);
    Result<> prepareStatements();
    Result<> chooseJournal();
    // The sentence is what a person is told meanwhile.
    LongStatements whileTelling(const std::wstring& sentence, bool canBeStopped);
    void lookAtAll(int version);
    void renewCopy(bool changed);
    Failure whatIsWrong(const Failure& found);
    Failure unreadable(const Failure& found);
    std::wstring whatHelps(int code);
    Result<> checkIsDamaged() const;
    Result<std::filesystem::path>
        replaceWith(Result<std::filesystem::path> (*replace)(const std::filesystem::path&));
    bool isFollowed(std::wstring_view path, Key from) const;
    void noteFollowed(std::wstring_view path, Key from, Key key);
    Key findChild(Key parent, std::wstring_view name);
    Result<Key> makePath(std::wstring_view path, Key from);
    Result<Key> createChild(Key parent, std::wstring_view name);
    Result<> beginWriting();
    void beginReading();
    void lookInto(Key key);
    void letGoOfRows();
    void forgetTransaction();
    void commit();
    void rollBack();
    Result<> checkBeforeRemoval();
    Result<> checkPlace();
    Result<> storeAdded();
    Result<> settle();
    Result<> finishWrite(int status);
    int readAhead(Key key, std::string_view fold);
    int step(Statement& statement);
    void failStep(int status);
    void endOfWork();
    bool isNext(Statement& statement, std::int64_t& last);
    Failure fail(int status);
    void failRead(const std::wstring& words, int code);
    Failure giveUp(Failure failure);
    void undoCommand();
    void closeHandlesOfLostKeys();

    const std::filesystem::path mFile;
    LongWork mWork;
    LockWait mWait;
    Result<> mCanStore;
    std::optional<std::wstring> mNotice;
    sqlite3* mDatabase = nullptr;
    bool mReadOnly = false;
    bool mLeftOpen = false;  // a session has left its journal
    bool mLookedAt = false;  // the file is known to be sound
    bool mHasStored = false; // since the copy was made
    bool mDamaged = false;
    bool mUnreadable = false;
    bool mReadFailed = false; // in the running command
    bool mCannotLock = false; // for as long as the session lasts: the file system refuses
    std::unique_ptr<Statements> mStatements;
    Cursor mCursor;
    ReadAhead mReadAhead;
    Followed mFollowed;                        // the last one: a list is read and written by one path
    Result<> mCommand;                         // the running one, or what failed in it first
    bool mWriting = false;                     // the running transaction is one that writes
    unsigned mWrites = 0;                      // in it
    std::unordered_set<Key> mOpenedForWriting; // by the running command
    std::unordered_map<HKEY, Key> mHandles;    // but the newest
    Handle mNewestHandle;
    std::uintptr_t mNextHandle;
};
} // namespace tessel
