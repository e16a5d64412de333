#include "host/registry/SoundCopy.h"

#include <array>
#include <cerrno>
#include <cstdio>
#include <memory>

#include <sys/stat.h>
#include <unistd.h>

#include "host/platform/OrdinaryFile.h"
#include "host/platform/PartFile.h"
#include "host/platform/SystemFailure.h"
#include "host/registry/Journals.h"
#include "host/registry/Schema.h"
#include "host/registry/Soundness.h"
#include "host/registry/StoreFailure.h"
#include "host/text/DayAndTime.h"
#include "host/text/Translation.h"

namespace tessel
{
namespace
{
constexpr int kNoCopy = SQLITE_NOTFOUND;

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
        return Failure{translated(L"it is of another version")};
    auto sound = checkTables(database, kSchemaVersion);
    return sound ? checkSoundness(database, kSchemaVersion) : sound;
}

using Database = std::unique_ptr<sqlite3, CloseDatabase>;

// The copy, if it is sound, opened for reading.
Result<Database> openCopy(const std::filesystem::path& copy)
{
    struct stat status = {};
    if (stat(copy.c_str(), &status) != 0)
        return errno == ENOENT ? Failure{translated(L"there is none"), kNoCopy} : fileFailure(errno);
    if (const auto ordinary = checkOrdinary(status); !ordinary)
        return ordinary.failure();
    sqlite3* opened = nullptr;
    constexpr int kFlags = SQLITE_OPEN_READONLY | SQLITE_OPEN_URI;
    const int answer = sqlite3_open_v2(asFixedFile(copy).c_str(), &opened, kFlags, nullptr);
    Database database(opened);
    const auto sound = answer == SQLITE_OK ? useCopy(opened) : Result<>(storeFailure(opened, answer));
    return sound ? Result<Database>(std::move(database)) : sound.failure();
}

Result<std::string> readCopy(const std::filesystem::path& copy)
{
    const auto database = openCopy(copy);
    if (!database)
        return database.failure();
    sqlite3_int64 size = 0;
    const Image image(sqlite3_serialize(database->get(), "main", &size, 0), sqlite3_free);
    if (!image)
        return storeFailure(database->get(), SQLITE_NOMEM);
    return std::string(image.get(), image.get() + size);
}

std::filesystem::path nameToKeep(const std::filesystem::path& file)
{
    return freeNameLike(beside(file, ".damaged"));
}

// What stands at the path gets a second name. A folder, which can have only one name, loses its first.
// Whether anything stood there.
Result<bool> nameToo(const std::filesystem::path& file, const std::filesystem::path& second)
{
    std::error_code unreachable;
    const bool isFolder = is_directory(symlink_status(file, unreachable));
    const int status = isFolder ? rename(file.c_str(), second.c_str()) : link(file.c_str(), second.c_str());
    if (status != 0 && errno != ENOENT)
        return systemFailure(errno);
    return status == 0;
}

// A journal is part of the file that it was written for.
Result<> setJournalsAside(const std::filesystem::path& file, const std::filesystem::path& kept)
{
    for (const auto journalOf : {logOf, rollbackJournalOf})
        if (rename(journalOf(file).c_str(), journalOf(kept).c_str()) != 0 && errno != ENOENT)
            return systemFailure(errno);
    unlink(indexOfLog(file).c_str());
    return {};
}

// Keeps what stands at the path, with its journals, under that name too. Whether anything stood there.
Result<bool> keep(const std::filesystem::path& file, const std::filesystem::path& kept)
{
    auto named = nameToo(file, kept);
    const Result<> done = named ? setJournalsAside(file, kept) : named.failure();
    return done ? named : done.failure();
}

// Under a name that is free, and no longer under its own: which, or none when nothing stood there.
Result<std::filesystem::path> moveAside(const std::filesystem::path& file)
{
    const auto kept = nameToKeep(file);
    const auto stood = keep(file, kept);
    if (!stood)
        return stood.failure();
    if (unlink(file.c_str()) != 0 && errno != ENOENT)
        return systemFailure(errno);
    return *stood ? kept : std::filesystem::path();
}

Failure notRestored(const std::filesystem::path& file, const std::wstring& reason)
{
    return {translated(L"The registry {} was not restored: {}.", file, reason)};
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
    return dayAndTimeInWords(status.st_mtime);
}

std::wstring helpAgainstDamage(const std::filesystem::path& file)
{
    const auto sound = checkSoundCopy(file);
    if (sound)
        return translated(L"REGISTRY RESTORE puts back the copy of {}.", timeOfCopy(file));
    if (sound.code() == kNoCopy)
        return translated(L"There is no copy of an earlier state. REGISTRY RESET sets it aside and begins "
                          L"with an empty one.");
    return translated(
        L"Its copy {} is of no use: {}. REGISTRY RESET sets both aside and begins with an empty one.",
        soundCopyOf(file), sound.sentence());
}

Result<> checkSoundCopy(const std::filesystem::path& file)
{
    const auto copy = openCopy(soundCopyOf(file));
    return copy ? Result<>() : copy.failure();
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
        return notRestored(file, translated(L"there is no copy of an earlier state"));
    const auto bytes = readCopy(copy);
    if (!bytes)
        return notRestored(file, translated(L"its copy {} cannot be used: {}", copy, bytes.sentence()));
    const auto kept = nameToKeep(file);
    const auto stood = keep(file, kept);
    const Result<> done = stood ? replaceFile(file, *bytes) : stood.failure();
    if (!done)
        return notRestored(file, done.sentence());
    return *stood ? kept : std::filesystem::path();
}

Result<std::filesystem::path> setAside(const std::filesystem::path& file)
{
    auto moved = moveAside(soundCopyOf(file));
    if (moved)
        moved = moveAside(file);
    return moved
               ? moved
               : Failure{translated(L"The registry {} could not be set aside: {}.", file, moved.sentence())};
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
