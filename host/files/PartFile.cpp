#include "host/files/PartFile.h"

#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <system_error>

#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr std::string_view kPrefix = ".part-";
constexpr mode_t kForAll = 0666;

Failure lastError()
{
    return {toWide(std::strerror(errno))};
}

bool hasName(int file)
{
    struct stat status = {};
    return fstat(file, &status) == 0 && status.st_nlink > 0;
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
    mMade = lastError();
    mPath.clear();
}

bool PartFile::write(std::string_view bytes)
{
    return mFile.write(bytes);
}

bool PartFile::letOthersRead()
{
    const mode_t taken = umask(0);
    umask(taken);
    return fchmod(mFile.number(), kForAll & ~taken) == 0;
}

Result<> PartFile::moveTo(const std::filesystem::path& place)
{
    // On the disk before it has its name: a power cut leaves all of it or none.
    if (fsync(mFile.number()) != 0 || rename(mPath.c_str(), place.c_str()) != 0)
        return lastError();
    mPath.clear();
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
} // namespace tessel
