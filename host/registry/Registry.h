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
// Status codes are those of the Windows-style registry calls (wincompat/wintypes.h).
#pragma once

#include <wincompat/winreg.h>

#include <cstdint>
#include <filesystem>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <unordered_set>
#include <vector>

struct sqlite3;

namespace tessel
{
class Registry
{
public:
    using Key = std::int64_t;
    static constexpr Key kNoKey = 0;
    static constexpr Key kRoot = 1; // HKEY_CURRENT_USER

    struct Value
    {
        std::wstring name; // empty: the key's unnamed value
        std::wstring data;
    };

    // Opens the file or makes it. A file that cannot be used is left as it is: reads then find nothing and
    // writes fail. A file marked read-only is only read.
    explicit Registry(std::filesystem::path file);
    ~Registry();
    Registry(const Registry&) = delete;
    Registry& operator=(const Registry&) = delete;

    // Empty, or one sentence about why nothing can be stored.
    const std::wstring& problem() const { return mProblem; }

    // Paths are relative to `from`; the parts are separated by one backslash, empty parts are passed over.
    Key find(std::wstring_view path, Key from = kRoot);
    // Opens the key for writing, and makes it if need be. A key that is there already locks nobody out: it is
    // the way in which everybody makes sure of a key before reading below it.
    LONG create(std::wstring_view path, Key from, Key& key);
    std::vector<std::wstring> subKeys(Key key);
    // Removes the key, its values and everything below it.
    LONG removeKey(Key key);

    LONG readValue(Key key, std::wstring_view name, std::wstring& data);
    LONG writeValue(Key key, std::wstring_view name, std::wstring_view data);
    LONG removeValue(Key key, std::wstring_view name);
    // The name of the value at an index from 0; cheap for indexes asked for in ascending order.
    LONG valueName(Key key, DWORD index, std::wstring& name);
    std::vector<Value> values(Key key);

    // The same by path, for the host's own settings.
    std::optional<std::wstring> read(std::wstring_view path, std::wstring_view name);
    bool write(std::wstring_view path, std::wstring_view name, std::wstring_view data);

    // Stores what the command wrote. When that or something before it failed, everything that the command
    // wrote is undone, one sentence says so, and the answer is false.
    bool endOfCommand();

    // Stores what the command wrote so far, and reads as it stands from now on. A failure stays the
    // command's, and is told at its end.
    void storeSoFar();

    // Handles for the registry calls. A handle that is not open is recognised, never followed.
    HKEY openHandle(Key key);
    std::optional<Key> keyOf(HKEY handle) const;
    bool closeHandle(HKEY handle);

private:
    struct Statements;
    struct Cursor
    {
        Key key = kNoKey;
        DWORD index = 0;
        std::int64_t sequence = 0;
    };

    void open();
    LONG openFile();
    LONG checkOrigin(int& version);
    LONG prepare();
    Key findChild(Key parent, std::wstring_view name);
    LONG createChild(Key parent, std::wstring_view name, Key& key);
    LONG beginWriting();
    void beginReading();
    void lookInto(Key key);
    void commit();
    void rollBack();
    LONG finishWrite(int status);
    bool isRow(int status);
    LONG fail(int status, const wchar_t* done);
    void closeHandlesOfLostKeys();
    std::wstring storeWords() const;

    std::filesystem::path mFile;
    std::wstring mProblem;
    sqlite3* mDatabase = nullptr;
    bool mReadOnly = false;
    std::unique_ptr<Statements> mStatements;
    Cursor mCursor;
    LONG mFailure = ERROR_SUCCESS; // of the running command, its first one
    std::wstring mFailureWords;
    bool mWriting = false;                     // the running transaction is one that writes
    unsigned mWrites = 0;                      // in it
    std::unordered_set<Key> mOpenedForWriting; // by the running command
    std::unordered_map<HKEY, Key> mHandles;
    std::uintptr_t mNextHandle;
};

// Gives a new registry its first profile, "Default", unless a current profile is set already.
void ensureCurrentProfile(Registry& registry, std::wstring_view productRoot);
} // namespace tessel
