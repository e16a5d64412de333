#include "host/registry/StoreFailure.h"

#include <cerrno>

#include "host/platform/SystemFailure.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr int kKind = 0xFF; // of a status: the rest says more

// Nobody has the rights that are missing there.
constexpr int kOfReadOnlyFileSystem = SQLITE_PERM | 0x100;

int kindOf(int status)
{
    return status & kKind;
}

int lastErrorOf(sqlite3_file* file)
{
    int error = 0;
    if (file && file->pMethods)
        file->pMethods->xFileControl(file, SQLITE_FCNTL_LAST_ERRNO, &error);
    return error;
}

// The store keeps the error with its own words or, where it wrote behind them, with the file that it wrote.
int systemErrorOf(sqlite3* database, int status)
{
    const bool isOfTheWords = kindOf(sqlite3_errcode(database)) == kindOf(status);
    if (const int error = sqlite3_system_errno(database); isOfTheWords && error != 0)
        return error;
    for (const int pointer : {SQLITE_FCNTL_JOURNAL_POINTER, SQLITE_FCNTL_FILE_POINTER})
    {
        sqlite3_file* file = nullptr;
        sqlite3_file_control(database, "main", pointer, &file);
        if (const int error = lastErrorOf(file); error != 0)
            return error;
    }
    return 0;
}

int codeOf(int systemError)
{
    switch (systemError)
    {
    case ENOSPC:
    case EDQUOT:
        return SQLITE_FULL;
    case EFBIG:
        return SQLITE_TOOBIG;
    case EACCES:
    case EPERM:
        return SQLITE_PERM;
    case EROFS:
        return kOfReadOnlyFileSystem;
    default:
        return SQLITE_CANTOPEN;
    }
}

// The store takes a disk that does not answer for a file that is damaged.
bool couldNotBeRead(sqlite3* database)
{
    sqlite3_file* file = nullptr;
    sqlite3_file_control(database, "main", SQLITE_FCNTL_FILE_POINTER, &file);
    return lastErrorOf(file) == EIO;
}

std::wstring wordsOf(sqlite3* database, int status)
{
    const bool hasWords = kindOf(sqlite3_errcode(database)) == kindOf(status);
    return toWide(hasWords ? sqlite3_errmsg(database) : sqlite3_errstr(status));
}

Failure systemsFailure(sqlite3* database, int status)
{
    const int error = systemErrorOf(database, status);
    if (error == 0)
        return {wordsOf(database, status), status};
    // Where a file can be made neither for writing nor for reading, what it says of the second is no reason.
    if (error == ENOENT)
        return {translated(L"a file beside it cannot be made"), status};
    const int code = codeOf(error);
    return {systemFailure(error).sentence, code == SQLITE_CANTOPEN ? status : code};
}

std::wstring whatHelpsFirst(int code)
{
    if (code == kOfReadOnlyFileSystem)
        return translated(L"Have the file system made writable");
    switch (kindOf(code))
    {
    case SQLITE_BUSY:
        return translated(L"Close that program, or let it finish");
    case SQLITE_FULL:
        return translated(L"Make room on the disk");
    case SQLITE_TOOBIG:
        return translated(L"Lift the limit on the size of files");
    case SQLITE_PERM:
    case SQLITE_READONLY:
        return translated(L"Give yourself the right to read and write the file and its folder");
    case SQLITE_CANTOPEN:
        return translated(L"Make sure that files can be made and opened there");
    case kOfAnotherProgram:
        return translated(L"Move that file elsewhere, or name another folder by --profile-dir");
    case kOfANewerTessel:
        return translated(L"Use that Tessel, or name another folder by --profile-dir");
    case kInTheWay:
        return translated(L"Remove that");
    default:
        return {};
    }
}
} // namespace

Failure storeFailure(sqlite3* database, int status)
{
    const int extended = sqlite3_extended_errcode(database);
    switch (kindOf(status))
    {
    case SQLITE_BUSY:
        return {translated(L"another program holds it"), status};
    case SQLITE_FULL:
        return {systemFailure(ENOSPC).sentence, status};
    case SQLITE_READONLY:
        return {extended == SQLITE_READONLY_DIRECTORY ? translated(L"its folder may not be written")
                                                      : translated(L"it may not be written"),
                status};
    case SQLITE_PROTOCOL:
        return {translated(L"the file system refuses its locks"), status};
    case SQLITE_IOERR:
    case SQLITE_CANTOPEN:
        return systemsFailure(database, status);
    case SQLITE_CORRUPT:
        if (couldNotBeRead(database))
            return {systemFailure(EIO).sentence, SQLITE_IOERR};
        return {wordsOf(database, status), status};
    default:
        return {wordsOf(database, status), status};
    }
}

Failure fileFailure(int systemError)
{
    return {systemFailure(systemError).sentence, codeOf(systemError)};
}

bool isDamage(int code)
{
    return kindOf(code) == SQLITE_CORRUPT || kindOf(code) == SQLITE_NOTADB;
}

bool isUnreadable(int code)
{
    return kindOf(code) == SQLITE_IOERR;
}

bool isRefusal(int code)
{
    switch (kindOf(code))
    {
    case SQLITE_CANTOPEN:
    case SQLITE_READONLY:
    case SQLITE_IOERR:
    case SQLITE_FULL:
    case SQLITE_TOOBIG:
    case SQLITE_PERM:
        return true;
    default:
        return false;
    }
}

std::wstring whatHelpsAtStart(int code)
{
    const std::wstring first = whatHelpsFirst(code);
    return first.empty() ? translated(L"Start Tessel again.")
                         : translated(L"{}, and start Tessel again.", first);
}

std::wstring whatHelpsInSession(int code)
{
    const std::wstring first = whatHelpsFirst(code);
    return first.empty() ? first : translated(L"{}, and try again.", first);
}
} // namespace tessel
