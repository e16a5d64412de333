#include "host/platform/RegularFile.h"

#include <cstring>
#include <utility>

#include <sys/stat.h>
#include <unistd.h>

#include "host/platform/DirectOpening.h"
#include "host/platform/OrdinaryFile.h"
#include "host/text/Translation.h"

namespace tessel
{
RegularFile::RegularFile(const std::string& path)
{
    struct stat status = {};
    auto direct = openDirectly(path, kToReadOrdinary);
    mReachedDirectly = static_cast<bool>(direct);
    auto file = direct ? ordinaryFile(std::move(direct), status) : openOrdinaryFile(path, status);
    mIdentity = {status.st_dev, status.st_ino};
    mSize = static_cast<std::uint64_t>(status.st_size);
    if (!file)
        mOpened = file.failure();
    else if (mSize == 0)
        mOpened = Failure{translated(L"the file is empty")};
    else
        mFile = *std::move(file);
}

bool RegularFile::keepsItsSize() const
{
    struct stat status = {};
    return fstat(mFile.number(), &status) == 0 && static_cast<std::uint64_t>(status.st_size) == mSize;
}

void RegularFile::readHead() const
{
    const ssize_t length = pread(mFile.number(), mHead.data(), mHead.size(), 0);
    mHeadLength = length > 0 ? static_cast<std::size_t>(length) : 0;
}

bool RegularFile::read(std::uint64_t offset, void* buffer, std::size_t size) const
{
    if (size > mSize || offset > mSize - size)
        return false;
    if (mHeadLength == 0)
        readHead();
    if (offset + size > mHeadLength)
        return pread(mFile.number(), buffer, size, static_cast<off_t>(offset)) == static_cast<ssize_t>(size);
    std::memcpy(buffer, mHead.data() + offset, size);
    return true;
}
} // namespace tessel
