// A plain file, open for reading. Whatever else stands at a path (a folder, a pipe, a device, nothing) is
// told apart in words, without ever waiting for it.
#pragma once

#include <array>
#include <compare>
#include <cstddef>
#include <cstdint>
#include <string>

#include <sys/types.h>

#include "host/platform/OrdinaryFile.h"

namespace tessel
{
// Which file it is, however its path is spelled and through whatever links it was reached.
struct FileIdentity
{
    dev_t device = 0;
    ino_t inode = 0;

    // clang-tidy 14 takes the comparison with 0 inside for a null pointer.
    auto operator<=>(const FileIdentity&) const = default; // NOLINT(modernize-use-nullptr)
};

class RegularFile
{
public:
    explicit RegularFile(const std::string& path);

    // Whether the file is open; why not is the end of a sentence. kNothingThere is a code of it.
    const Result<>& opened() const { return mOpened; }

    const FileIdentity& identity() const { return mIdentity; }
    std::uint64_t size() const { return mSize; }
    // Whether that is still so.
    bool keepsItsSize() const;

    // Whether no symbolic link was followed on the way to it; no where the system cannot say.
    bool reachedDirectly() const { return mReachedDirectly; }

    // While the file is open.
    int descriptor() const { return mFile.number(); }

    // Fills the buffer from an offset; false when the file does not hold that many bytes there.
    bool read(std::uint64_t offset, void* buffer, std::size_t size) const;

private:
    // Everything that tells whether a library can be mapped usually stands here, so that one read serves.
    static constexpr std::size_t kHeadSize = 1024;

    void readHead() const;

    Descriptor mFile{-1};
    Result<> mOpened;
    FileIdentity mIdentity;
    std::uint64_t mSize = 0;
    bool mReachedDirectly = false;
    mutable std::array<unsigned char, kHeadSize> mHead;
    mutable std::size_t mHeadLength = 0; // 0: not read yet
};
} // namespace tessel
