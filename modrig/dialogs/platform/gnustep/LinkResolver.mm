#include "modrig/dialogs/platform/LinkResolver.h"

#import <Foundation/Foundation.h>

#include <cerrno>
#include <cstdlib>
#include <limits.h>
#include <string>
#include <unordered_map>

#include <dirent.h>
#include <unistd.h>

#include "modrig/dialogs/Paths.h"

namespace ModrigPlatform
{
namespace
{
// Reading the name of an entry takes a quarter of the time that the question about a file does.
constexpr std::size_t kNamesForOneQuestion = 4;

// Whether the folder holds no links, as far as that can be told from the names of so many entries at most.
bool HoldsNoLinks(const std::string& folder, std::size_t most)
{
    DIR* entries = opendir(folder.c_str());
    if (!entries)
        return false;
    errno = 0;
    const dirent* entry = readdir(entries);
    while (entry && entry->d_type != DT_LNK && entry->d_type != DT_UNKNOWN && most-- > 0)
        entry = readdir(entries);
    const bool readToItsEnd = !entry && errno == 0;
    closedir(entries);
    return readToItsEnd;
}

// A folder, with its slash.
class Folder
{
public:
    std::size_t expected = 0; // files in it that will be asked about

    void LookUpOnce(std::wstring_view folder)
    {
        if (mBytes.empty())
            LookUp(folder);
    }

    bool IsThere() const { return mIsThere; }
    bool LeadsElsewhere() const { return !mResolved.empty(); }
    bool HasNoLinks() const { return mHasNoLinks; }
    const std::string& Bytes() const { return mBytes; }
    const std::wstring& Resolved() const { return mResolved; } // where it leads elsewhere

private:
    void LookUp(std::wstring_view folder);

    bool mIsThere = false;
    bool mHasNoLinks = false;
    std::wstring mResolved;
    std::string mBytes;
};

// Written in another way, with two slashes, say, it leads elsewhere too: to the path that is written plainly.
void Folder::LookUp(std::wstring_view folder)
{
    mBytes = [ModrigUtils::StringFromPath(CStdStr(folder)) fileSystemRepresentation];
    char place[PATH_MAX];
    mIsThere = realpath(mBytes.c_str(), place) != nullptr;
    if (!mIsThere)
        return;
    const std::string found = std::string(place) + (place[1] ? "/" : "");
    if (found == mBytes)
        mHasNoLinks = expected > 1 && HoldsNoLinks(mBytes, expected * kNamesForOneQuestion);
    else
        mResolved = ModrigUtils::PathFromString([[NSFileManager defaultManager]
                                                    stringWithFileSystemRepresentation:found.c_str()
                                                                                length:found.size()])
                        .Text();
}

enum class Entry
{
    kPlain,
    kLink,
    kMissing
};

// What the system looks up for the last part of a path when it resolves the path.
Entry EntryAt(const std::string& path)
{
    char target;
    if (readlink(path.c_str(), &target, 1) >= 0)
        return Entry::kLink;
    return errno == EINVAL ? Entry::kPlain : Entry::kMissing;
}

// A path in a folder, where it is written so that the folder can be resolved apart from it.
struct Parts
{
    explicit Parts(const CStdStr& path)
        : folder(path.Text().data(), path.Text().rfind(L'/') + 1),
          name(std::wstring_view(path.Text()).substr(folder.size()))
    {
    }
    bool AreApart() const
    {
        return !folder.empty() && folder.front() == L'/' && !name.empty() && name != L"." && name != L".." &&
               ModrigUtils::IsAscii(name);
    }

    std::wstring_view folder;
    std::wstring_view name;
};

// Resolving a path looks at every folder on the way to it, and most of many paths share theirs. Each folder
// is resolved once; of the file itself remains the question whether it is a link, and one look at the folder
// answers that for many.
class FolderByFolder : public LinkResolver
{
public:
    void Expect(const CStdStr& path) override
    {
        const Parts parts(path);
        if (parts.AreApart())
            ++FolderAt(parts.folder).expected;
    }

    const CStdStr& Resolve(const CStdStr& path) override
    {
        const Parts parts(path);
        if (!parts.AreApart())
            return AskToolkit(path);
        Folder& folder = FolderAt(parts.folder);
        folder.LookUpOnce(parts.folder);
        if (!folder.IsThere() || folder.HasNoLinks())
            return path;
        return ResolveIn(folder, path, parts.name);
    }

private:
    const CStdStr& ResolveIn(const Folder& folder, const CStdStr& path, std::wstring_view name)
    {
        mBytes.assign(folder.Bytes()).append(name.begin(), name.end());
        const Entry entry = EntryAt(mBytes);
        if (entry == Entry::kLink)
            return AskToolkit(path);
        if (entry == Entry::kMissing || !folder.LeadsElsewhere())
            return path;
        mResolved = CStdStr(folder.Resolved() + std::wstring(name));
        return mResolved;
    }

    const CStdStr& AskToolkit(const CStdStr& path)
    {
        mResolved = ModrigUtils::ResolvedByToolkit(path);
        return mResolved;
    }

    Folder& FolderAt(std::wstring_view folder)
    {
        if (!mLast || folder != mLast->first)
            mLast = &*mFolders.try_emplace(std::wstring(folder)).first;
        return mLast->second;
    }

    std::unordered_map<std::wstring, Folder> mFolders;
    std::pair<const std::wstring, Folder>* mLast = nullptr;
    std::string mBytes;
    CStdStr mResolved;
};
} // namespace

std::unique_ptr<LinkResolver> MakeLinkResolver()
{
    return std::make_unique<FolderByFolder>();
}
} // namespace ModrigPlatform
