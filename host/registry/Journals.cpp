#include "host/registry/Journals.h"

#include <sqlite3.h>

#include <array>
#include <cerrno>
#include <cstdint>
#include <cstdio>
#include <cstring>
#include <fstream>
#include <optional>
#include <string_view>
#include <vector>

#include "host/registry/StoreFailure.h"
#include "host/text/Hexadecimal.h"
#include "host/text/Translation.h"

namespace tessel
{
namespace
{
// The store's file formats (sqlite.org/fileformat2.html). Numbers are big-endian.
constexpr std::size_t kFileHeader = 100;
constexpr std::size_t kChangeCount = 24;
constexpr std::size_t kFileNumber = 68;
constexpr std::size_t kLogHeader = 32;
constexpr std::size_t kLogPageSize = 8;
constexpr std::size_t kLogSalt = 16;
constexpr std::size_t kFrameHeader = 24;
constexpr std::size_t kFrameCommit = 4; // not 0 in the last frame of a transaction
constexpr std::size_t kFrameSalt = 8;
constexpr std::size_t kSalt = 8;
constexpr std::uint32_t kSmallestPage = 512;
constexpr std::uint32_t kLargestPage = 65536;

// Which file it is, and in which of its states.
struct Identity
{
    std::uint32_t number = 0;
    std::uint32_t count = 0;
};

struct LogIdentity
{
    Identity first, last;
};

std::uint32_t numberAt(const char* bytes, std::size_t offset)
{
    std::uint32_t number = 0;
    for (std::size_t i = 0; i < sizeof number; ++i)
        number = number << 8U | static_cast<unsigned char>(bytes[offset + i]);
    return number;
}

Identity identityIn(const char* firstPage)
{
    return {numberAt(firstPage, kFileNumber), numberAt(firstPage, kChangeCount)};
}

// The file itself, without what a log may hold. By the store, since closing a file takes a process's locks on
// it away.
std::optional<Identity> identityOf(const std::filesystem::path& file)
{
    sqlite3* database = nullptr;
    sqlite3_file* opened = nullptr;
    char header[kFileHeader] = {};
    constexpr int kFlags = SQLITE_OPEN_READONLY | SQLITE_OPEN_URI | SQLITE_OPEN_NOMUTEX;
    int status = sqlite3_open_v2(asFixedFile(file).c_str(), &database, kFlags, nullptr);
    if (status == SQLITE_OK)
        status = sqlite3_file_control(database, "main", SQLITE_FCNTL_FILE_POINTER, &opened);
    if (status == SQLITE_OK && opened && opened->pMethods)
        status = opened->pMethods->xRead(opened, header, sizeof header, 0);
    else
        status = SQLITE_CANTOPEN;
    sqlite3_close(database);
    return status == SQLITE_OK ? std::optional(identityIn(header)) : std::nullopt;
}

// The first pages of the file that the log holds: the oldest and the newest. None when the log holds nothing
// that the store would take; a number of 0 when no first page is in it.
std::optional<LogIdentity> identityOfLog(const std::filesystem::path& log)
{
    std::ifstream stream(log, std::ios::binary);
    std::array<char, kLogHeader> header = {};
    if (!stream.read(header.data(), header.size()))
        return std::nullopt;
    const std::uint32_t pageSize = numberAt(header.data(), kLogPageSize);
    if (pageSize < kSmallestPage || pageSize > kLargestPage)
        return std::nullopt;
    std::vector<char> frame(kFrameHeader + pageSize);
    LogIdentity seen;
    std::optional<LogIdentity> committed;
    while (stream.read(frame.data(), static_cast<std::streamsize>(frame.size())) &&
           std::memcmp(&frame[kFrameSalt], &header[kLogSalt], kSalt) == 0)
    {
        if (numberAt(frame.data(), 0) == 1)
            seen.last = identityIn(&frame[kFrameHeader]);
        if (seen.first.number == 0)
            seen.first = seen.last;
        if (numberAt(frame.data(), kFrameCommit) != 0)
            committed = seen;
    }
    return committed;
}

// The file is looked at before the log and after it: another session may be carrying pages over meanwhile.
bool belongs(const Identity& before, const LogIdentity& log, const Identity& after)
{
    // A version without numbers has written it, or its first transaction with one.
    if (before.number == 0)
        return true;
    return log.first.number == before.number && log.last.number == before.number &&
           log.first.count <= after.count + 1 && before.count <= log.last.count;
}

bool isTaken(const std::filesystem::path& path)
{
    std::error_code unreachable;
    return exists(symlink_status(path, unreachable));
}

bool isForeign(const std::filesystem::path& file)
{
    std::error_code missing;
    if (!std::filesystem::exists(logOf(file), missing)) // as mostly
        return false;
    const auto before = identityOf(file);
    const auto log = identityOfLog(logOf(file));
    const auto after = identityOf(file);
    return before && log && after && !belongs(*before, *log, *after);
}
} // namespace

std::filesystem::path logOf(const std::filesystem::path& file)
{
    return file.string() + "-wal";
}

std::filesystem::path rollbackJournalOf(const std::filesystem::path& file)
{
    return file.string() + "-journal";
}

std::filesystem::path indexOfLog(const std::filesystem::path& file)
{
    return file.string() + "-shm";
}

// One that is kept for the next transaction is empty or begins with a zero.
bool isInUse(const std::filesystem::path& journal)
{
    std::ifstream stream(journal, std::ios::binary);
    return stream.get() > 0;
}

std::filesystem::path freeNameLike(const std::filesystem::path& first)
{
    auto name = first;
    for (int number = 2; isTaken(name) || isTaken(logOf(name)) || isTaken(rollbackJournalOf(name)); ++number)
        name = first.string() + "-" + std::to_string(number);
    return name;
}

Result<std::optional<std::wstring>> setForeignLogAside(const std::filesystem::path& file)
{
    if (!isForeign(file))
        return std::optional<std::wstring>();
    const auto log = logOf(file);
    const auto aside = freeNameLike(log.string() + ".foreign");
    if (rename(log.c_str(), aside.c_str()) != 0)
    {
        const Failure failure = fileFailure(errno);
        return Failure{translated(L"the write-ahead log {} does not belong to it, but to another registry or "
                                  L"to another state of it, and cannot be set aside: {}",
                                  log, failure.sentence),
                       failure.code};
    }
    static_cast<void>(std::remove(indexOfLog(file).c_str()));
    return std::optional(
        translated(L"The registry {} is read without its log: the write-ahead log {} does not belong to it, "
                   L"but to another registry or to another state of it. It was set aside as {}.",
                   file, log, aside));
}

std::string asFixedFile(const std::filesystem::path& file)
{
    std::string uri = "file:";
    for (const char character : std::filesystem::absolute(file).string())
    {
        if (std::string_view("%?#").find(character) == std::string_view::npos)
        {
            uri += character;
            continue;
        }
        uri += '%' + hexadecimal<char>(static_cast<unsigned char>(character));
    }
    return uri + "?immutable=1";
}

bool hasJournal(const std::filesystem::path& file)
{
    std::error_code missing;
    return std::filesystem::exists(logOf(file), missing) ||
           std::filesystem::exists(rollbackJournalOf(file), missing);
}
} // namespace tessel
