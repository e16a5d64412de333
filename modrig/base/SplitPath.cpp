#include "modrig/base/SplitPath.h"

#include <wincompat/winfile.h>

#include "modrig/base/CaseFolding.h"

SplitPath::SplitPath(const CStdStr& path)
{
    if (_wsplitpath_s(path.c_str(), mDrive, kDriveSize, mFolder, kFolderSize, mName, kNameSize, mExtension,
                      kExtensionSize) != 0)
        mTooLong = path;
}

CStdStr SplitPath::FileName() const
{
    return CStdStr(std::wstring(mName) + mExtension);
}

bool SplitPath::HasExtension(std::wstring_view extension) const
{
    return EqualIgnoringCase(mExtension, extension);
}

// Name and extension are cut at the last dot in both, so that they are equal together exactly when they are
// equal one by one; the same goes for drive and folder.
bool SplitPath::SameFileName(const SplitPath& other) const
{
    return EqualIgnoringCase(mName, other.mName) && EqualIgnoringCase(mExtension, other.mExtension) &&
           mTooLong.EqualsNoCase(other.mTooLong);
}

bool SplitPath::SameFolder(const SplitPath& other) const
{
    return EqualIgnoringCase(mDrive, other.mDrive) && EqualIgnoringCase(mFolder, other.mFolder);
}

std::size_t SplitPath::FileNameHash() const
{
    return HashIgnoringCase(mTooLong.Text(), HashIgnoringCase(mExtension, HashIgnoringCase(mName)));
}

// The parts stand in the path one after the other, with nothing between them.
std::size_t WholePathHash(const CStdStr& path)
{
    return HashIgnoringCase(path.Text());
}
