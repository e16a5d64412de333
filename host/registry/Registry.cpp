#include "host/registry/Registry.h"

#include <sqlite3.h>

#include <algorithm>

#include "host/Services.h"
#include "host/registry/Statements.h"
#include "host/text/CommandLine.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr std::uintptr_t kFirstHandle = 0x1000;
// Written pages are handed to the file system after each of the first writes of a command and every so often
// later, so that a full disk shows at the write that it hits and the caller can tell its user.
constexpr unsigned kWritesFlushedAtOnce = 64;

std::wstring_view takePart(std::wstring_view& path)
{
    const std::size_t end = std::min(path.find(L'\\'), path.size());
    const std::wstring_view part = path.substr(0, end);
    path.remove_prefix(std::min(end + 1, path.size()));
    return part;
}
} // namespace

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
    beginReading();
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
    mOpenedForWriting.insert(key);
    return ERROR_SUCCESS;
}

std::vector<std::wstring> Registry::subKeys(Key key)
{
    std::vector<std::wstring> names;
    if (!mDatabase)
        return names;
    beginReading();
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
    lookInto(key);
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
    lookInto(key);
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
    lookInto(key);
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
    if (mWriting)
        return ERROR_SUCCESS;
    // What was read by now is of a moment that may be over; the writes are to stand on what is stored now.
    commit();
    mWrites = 0;
    const int status = mStatements->begin.run();
    mWriting = status == SQLITE_DONE;
    return mWriting ? ERROR_SUCCESS : fail(status, L"written");
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
    if (mOpenedForWriting.contains(key))
        static_cast<void>(beginWriting());
    beginReading();
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
    {
        rollBack();
        return mFailure;
    }
    mFailure = statusOf(status);
    // Flushing leaves no words behind.
    const bool hasWords = sqlite3_errcode(mDatabase) != SQLITE_OK;
    const char* words = hasWords ? sqlite3_errmsg(mDatabase) : sqlite3_errstr(status);
    mFailureWords = std::wstring(L" could not be ") + done + L": " + toWide(words);
    rollBack();
    mCursor = {};
    closeHandlesOfLostKeys();
    return mFailure;
}

void Registry::rollBack()
{
    // SQLite may have rolled back by itself already.
    if (!sqlite3_get_autocommit(mDatabase))
        mStatements->rollback.run();
    mWriting = false;
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

void Registry::commit()
{
    if (sqlite3_get_autocommit(mDatabase))
        return;
    if (const int status = mStatements->commit.run(); status != SQLITE_DONE)
        fail(status, L"written");
    mWriting = false;
}

void Registry::storeSoFar()
{
    if (mDatabase)
        commit();
}

bool Registry::endOfCommand()
{
    if (!mDatabase)
        return true;
    commit();
    mOpenedForWriting.clear();
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
