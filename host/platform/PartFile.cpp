#include "host/platform/PartFile.h"

#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <system_error>

#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

#include "host/platform/SystemFailure.h"

namespace tessel
{
namespace
{
constexpr std::string_view kPrefix = ".tessel-part-"; // what others leave there is not cleared away
constexpr mode_t kForAll = 0666;
constexpr mode_t kRights = 0777;

// Where the system cannot say, it has: to make another file would not help.
bool hasName(int file)
{
    struct stat status = {};
    return fstat(file, &status) != 0 || status.st_nlink > 0;
}

// That a name leads to a file is on the disk only when its folder is. Not every file system can be asked.
void storeFolderOf(const std::filesystem::path& file)
{
    const std::filesystem::path path = file.has_parent_path() ? file.parent_path() : ".";
    const Descriptor folder(open(path.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC));
    if (folder)
        static_cast<void>(fsync(folder.number()));
}

void removeIfNobodyWrites(const std::filesystem::path& part)
{
    const Descriptor file(open(part.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK | O_NOFOLLOW));
    if (file && flock(file.number(), LOCK_EX | LOCK_NB) == 0)
        unlink(part.c_str());
}
} // namespace

PartFile::PartFile(const std::filesystem::path& folder)
{
    do
        make(folder);
    while (mMade && !hasName(mFile.number())); // taken for a left-over before it was locked
}

PartFile::~PartFile()
{
    if (!mPath.empty())
        unlink(mPath.c_str());
}

void PartFile::make(const std::filesystem::path& folder)
{
    mPath = (folder / kPrefix).string() + "XXXXXX";
    mFile = Descriptor(mkostemp(mPath.data(), O_CLOEXEC));
    if (mFile)
    {
        flock(mFile.number(), LOCK_EX); // a file system without locks keeps left-overs, that is all
        return;
    }
    mMade = systemFailure(errno);
    mPath.clear();
}

Result<> PartFile::write(std::string_view bytes)
{
    return mFile.write(bytes);
}

Result<> PartFile::letOthersRead(const std::filesystem::path& place)
{
    const mode_t taken = umask(0);
    umask(taken);
    struct stat there = {};
    const bool standsThere = lstat(place.c_str(), &there) == 0 && S_ISREG(there.st_mode);
    const mode_t rights = standsThere ? there.st_mode & kRights : kForAll & ~taken;
    return fchmod(mFile.number(), rights) == 0 ? Result<>() : systemFailure(errno);
}

Result<> PartFile::moveTo(const std::filesystem::path& place)
{
    auto named = name(place, std::rename);
    if (named)
        mPath.clear();
    return named;
}

Result<> PartFile::moveToOnce(const std::filesystem::path& place)
{
    return name(place, [](const char* part, const char* name)
                { return link(part, name) == 0 || errno == EEXIST ? 0 : -1; });
}

// On the disk before it has its name: a power cut leaves all of it or none.
Result<> PartFile::name(const std::filesystem::path& place, int (*naming)(const char*, const char*))
{
    if (fsync(mFile.number()) != 0 || naming(mPath.c_str(), place.c_str()) != 0)
        return systemFailure(errno);
    storeFolderOf(place);
    return {};
}

void PartFile::clearLeftOvers(const std::filesystem::path& folder)
{
    std::error_code unreachable; // then there is nothing to clear
    for (std::filesystem::directory_iterator entry(folder, unreachable), end; !unreachable && entry != end;
         entry.increment(unreachable))
        if (entry->path().filename().string().starts_with(kPrefix))
            removeIfNobodyWrites(entry->path());
}

Result<> replaceFile(const std::filesystem::path& place, std::string_view bytes)
{
    PartFile::clearLeftOvers(place.parent_path());
    PartFile part(place.parent_path());
    if (!part.made())
        return part.made();
    const auto written = part.write(bytes);
    return written ? part.moveTo(place) : written;
}

Result<> replacePersonsFile(const std::filesystem::path& place, std::string_view bytes)
{
    const auto folder = place.has_parent_path() ? place.parent_path() : ".";
    PartFile::clearLeftOvers(folder);
    PartFile part(folder);
    if (!part.made())
        return part.made();
    auto done = part.write(bytes);
    if (done)
        done = part.letOthersRead(place);
    return done ? part.moveTo(place) : done;
}
} // namespace tessel
