#include "host/registry/SoundCopy.h"

#include <array>
#include <cerrno>
#include <cstdio>
#include <cstring>
#include <memory>

#include <sys/stat.h>
#include <unistd.h>

#include "host/platform/PartFile.h"
#include "host/platform/SystemFailure.h"
#include "host/registry/Journals.h"
#include "host/registry/Schema.h"
#include "host/registry/Soundness.h"
#include "host/text/DayAndTime.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr std::array kJournals = {"-wal", "-journal"};

struct CloseDatabase
{
    void operator()(sqlite3* database) const { sqlite3_close(database); }
};

using Image = std::unique_ptr<unsigned char, void (*)(void*)>;

std::filesystem::path beside(const std::filesystem::path& file, const char* ending)
{
    return file.string() + ending;
}

Result<> useCopy(sqlite3* database)
{
    const int status = addChecksum(database);
    if (status != SQLITE_OK)
        return storeFailure(database, status);
    const auto version = firstNumber(database, "PRAGMA user_version");
    if (!version)
        return version.failure();
    if (*version != kSchemaVersion)
        return Failure{L"it is of another version"};
    auto sound = checkTables(database, kSchemaVersion);
    return sound ? checkSoundness(database, kSchemaVersion) : sound;
}

// The copy's bytes, if it is sound.
Result<std::string> readCopy(const std::filesystem::path& copy)
{
    sqlite3* opened = nullptr;
    constexpr int kFlags = SQLITE_OPEN_READONLY | SQLITE_OPEN_URI;
    const int status = sqlite3_open_v2(asFixedFile(copy).c_str(), &opened, kFlags, nullptr);
    const std::unique_ptr<sqlite3, CloseDatabase> database(opened);
    const auto sound = status == SQLITE_OK ? useCopy(opened) : Result<>(storeFailure(opened, status));
    if (!sound)
        return sound.failure();
    sqlite3_int64 size = 0;
    const Image image(sqlite3_serialize(opened, "main", &size, 0), sqlite3_free);
    if (!image)
        return storeFailure(opened, SQLITE_NOMEM);
    return std::string(image.get(), image.get() + size);
}

// What stands at the path gets a second name, in place of what had it before. A folder, which can have only
// one name, loses its first. Whether anything stood there.
Result<bool> nameToo(const std::filesystem::path& file, const std::filesystem::path& second)
{
    std::error_code unreachable;
    const bool isFolder = is_directory(symlink_status(file, unreachable));
    static_cast<void>(std::remove(second.c_str())); // if it stays, the next fails
    const int status = isFolder ? rename(file.c_str(), second.c_str()) : link(file.c_str(), second.c_str());
    if (status != 0 && errno != ENOENT)
        return systemFailure(errno);
    return status == 0;
}

// A journal is part of the file that it was written for.
Result<> setJournalsAside(const std::filesystem::path& file, const std::filesystem::path& kept)
{
    for (const char* ending : kJournals)
        if (rename(beside(file, ending).c_str(), beside(kept, ending).c_str()) != 0 && errno != ENOENT)
            return systemFailure(errno);
    unlink(beside(file, "-shm").c_str());
    return {};
}

Failure notRestored(const std::filesystem::path& file, const std::wstring& reason)
{
    return {L"The registry " + toWide(file.string()) + L" was not restored: " + reason + L"."};
}
} // namespace

std::filesystem::path soundCopyOf(const std::filesystem::path& file)
{
    return beside(file, ".sound");
}

std::wstring timeOfCopy(const std::filesystem::path& file)
{
    struct stat status = {};
    if (stat(soundCopyOf(file).c_str(), &status) != 0)
        return {};
    return toWide(dayAndTime(status.st_mtime));
}

std::wstring helpAgainstDamage(const std::filesystem::path& file)
{
    const std::wstring time = timeOfCopy(file);
    return time.empty() ? L"There is no copy of an earlier state."
                        : L"REGISTRY RESTORE puts back the copy of " + time + L".";
}

Result<> makeSoundCopy(sqlite3* database, const std::filesystem::path& file)
{
    sqlite3_int64 size = 0;
    const Image image(sqlite3_serialize(database, "main", &size, 0), sqlite3_free);
    if (!image)
        return storeFailure(database, sqlite3_errcode(database));
    const auto* bytes = reinterpret_cast<const char*>(image.get());
    return replaceFile(soundCopyOf(file), {bytes, static_cast<std::size_t>(size)});
}

Result<std::filesystem::path> putSoundCopyBack(const std::filesystem::path& file)
{
    const auto copy = soundCopyOf(file);
    if (timeOfCopy(file).empty())
        return notRestored(file, L"there is no copy of an earlier state");
    const auto bytes = readCopy(copy);
    if (!bytes)
        return notRestored(file,
                           L"its copy " + toWide(copy.string()) + L" cannot be used: " + bytes.sentence());
    const auto kept = beside(file, ".damaged");
    const auto named = nameToo(file, kept);
    Result<> done = named ? setJournalsAside(file, kept) : named.failure();
    if (done)
        done = replaceFile(file, *bytes);
    if (!done)
        return notRestored(file, done.sentence());
    return *named ? kept : std::filesystem::path();
}

Result<> makeFileOnce(const std::filesystem::path& file, std::string_view bytes)
{
    PartFile part(file.parent_path());
    if (!part.made())
        return part.made();
    const auto written = part.write(bytes);
    return written ? part.moveToOnce(file) : written;
}
} // namespace tessel
