// A path taken apart once, for the code that asks several questions about it.
#pragma once

#include <string_view>

#include "modrig/base/CStdStr.h"

// The parts as `_wsplitpath_s` gives them in buffers of 3, 1024, 256 and 256 characters. When one part does
// not fit, the path is too long: all parts are empty, and only the same whole path has the same file name.
class SplitPath
{
public:
    explicit SplitPath(const CStdStr& path);

    bool IsTooLong() const { return !mTooLong.IsEmpty(); }

    std::wstring_view Name() const { return mName; }
    // With its dot.
    std::wstring_view Extension() const { return mExtension; }
    // Name and extension.
    CStdStr FileName() const;

    bool HasExtension(std::wstring_view extension) const;

    // Whether both name the same file name, or the same folder (drive included), without regard to case.
    bool SameFileName(const SplitPath& other) const;
    bool SameFolder(const SplitPath& other) const;

    // Equal file names have equal hashes.
    std::size_t FileNameHash() const;

private:
    static constexpr std::size_t kDriveSize = 3;
    static constexpr std::size_t kFolderSize = 1024;
    static constexpr std::size_t kNameSize = 256;
    static constexpr std::size_t kExtensionSize = 256;

    wchar_t mDrive[kDriveSize];
    wchar_t mFolder[kFolderSize];
    wchar_t mName[kNameSize];
    wchar_t mExtension[kExtensionSize];
    CStdStr mTooLong; // the whole path when it could not be taken apart, else empty
};

// Paths that are equal in file name and folder have equal hashes.
std::size_t WholePathHash(const CStdStr& path);
