#include "host/platform/RegularFile.h"

#include <cerrno>
#include <cstring>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include "host/text/Unicode.h"

namespace tessel
{
RegularFile::RegularFile(const std::string& path)
    // Opening a pipe that nobody writes to would wait for a writer.
    : mDescriptor(open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK))
{
    struct stat status = {};
    if (mDescriptor < 0 || fstat(mDescriptor, &status) != 0)
    {
        const bool isMissing = errno == ENOENT || errno == ENOTDIR;
        refuse({toWide(std::strerror(errno)), isMissing ? kMissing : Failure::kUnspecified});
    }
    else if (S_ISDIR(status.st_mode))
        refuse({L"it is a folder, not a file"});
    else if (!S_ISREG(status.st_mode))
        refuse({L"it is not a regular file"});
    else if (status.st_size == 0)
        refuse({L"the file is empty"});
    mIdentity = {status.st_dev, status.st_ino};
    mSize = static_cast<std::uint64_t>(status.st_size);
}

RegularFile::~RegularFile()
{
    if (mDescriptor >= 0)
        close(mDescriptor);
}

void RegularFile::refuse(Failure failure)
{
    mOpened = std::move(failure);
    if (mDescriptor >= 0)
        close(mDescriptor);
    mDescriptor = -1;
}

bool RegularFile::keepsItsSize() const
{
    struct stat status = {};
    return fstat(mDescriptor, &status) == 0 && static_cast<std::uint64_t>(status.st_size) == mSize;
}

void RegularFile::readHead() const
{
    const ssize_t length = pread(mDescriptor, mHead.data(), mHead.size(), 0);
    mHeadLength = length > 0 ? static_cast<std::size_t>(length) : 0;
}

bool RegularFile::read(std::uint64_t offset, void* buffer, std::size_t size) const
{
    if (size > mSize || offset > mSize - size)
        return false;
    if (mHeadLength == 0)
        readHead();
    if (offset + size > mHeadLength)
        return pread(mDescriptor, buffer, size, static_cast<off_t>(offset)) == static_cast<ssize_t>(size);
    std::memcpy(buffer, mHead.data() + offset, size);
    return true;
}
} // namespace tessel
