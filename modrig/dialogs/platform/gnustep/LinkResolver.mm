#include "modrig/dialogs/platform/LinkResolver.h"

#import <Foundation/Foundation.h>

#include <algorithm>
#include <cerrno>
#include <cstdlib>
#include <limits.h>
#include <memory>
#include <string>
#include <unordered_map>

#include <unistd.h>

#include "modrig/dialogs/Paths.h"

namespace ModrigPlatform
{
namespace
{
constexpr wchar_t kFirstBeyondAscii = 0x80;

CStdStr ResolvedByToolkit(const CStdStr& path)
{
    return ModrigUtils::PathFromString(
        [ModrigUtils::StringFromPath(path) stringByResolvingSymlinksInPath]);
}

bool IsAscii(std::wstring_view text)
{
    return std::all_of(text.begin(), text.end(),
                       [](wchar_t character) { return character > 0 && character < kFirstBeyondAscii; });
}

// A folder with its slash, once it has been looked up.
struct Folder
{
    explicit Folder(std::wstring_view folder);

    bool isThere = false;
    bool leadsElsewhere = false;
    std::wstring resolved; // with a slash; only where it leads elsewhere
    std::string bytes;     // with a slash
};

// Written in another way, with two slashes, say, it leads elsewhere too: to the path that is written plainly.
Folder::Folder(std::wstring_view folder)
{
    bytes = [ModrigUtils::StringFromPath(CStdStr(folder)) fileSystemRepresentation];
    char place[PATH_MAX];
    isThere = realpath(bytes.c_str(), place) != nullptr;
    if (!isThere)
        return;
    const std::string found = std::string(place) + (place[1] ? "/" : "");
    leadsElsewhere = found != bytes;
    if (leadsElsewhere)
        resolved = ModrigUtils::PathFromString([[NSFileManager defaultManager]
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

// Resolving a path looks at every folder on the way to it, and most of many paths share theirs. Each folder
// is resolved once; of the file itself remains the question whether it is a link.
class FolderByFolder
{
public:
    const CStdStr& Resolve(const CStdStr& path)
    {
        const std::wstring_view text = path.Text();
        const std::size_t slash = text.rfind(L'/');
        const std::wstring_view name = text.substr(slash + 1);
        if (slash == std::wstring_view::npos || text.front() != L'/' || !IsPlainName(name))
            return AskToolkit(path);
        return Resolve(path, FolderAt(text.substr(0, slash + 1)), name);
    }

private:
    static bool IsPlainName(std::wstring_view name)
    {
        return !name.empty() && name != L"." && name != L".." && IsAscii(name);
    }

    const CStdStr& Resolve(const CStdStr& path, const Folder& folder, std::wstring_view name)
    {
        if (!folder.isThere)
            return path;
        mBytes.assign(folder.bytes).append(name.begin(), name.end());
        const Entry entry = EntryAt(mBytes);
        if (entry == Entry::kLink)
            return AskToolkit(path);
        if (entry == Entry::kMissing || !folder.leadsElsewhere)
            return path;
        mResolved = CStdStr(folder.resolved + std::wstring(name));
        return mResolved;
    }

    const CStdStr& AskToolkit(const CStdStr& path)
    {
        mResolved = ResolvedByToolkit(path);
        return mResolved;
    }

    const Folder& FolderAt(std::wstring_view folder)
    {
        if (!mLast || folder != mLast->first)
            mLast = &*mFolders.try_emplace(std::wstring(folder), folder).first;
        return mLast->second;
    }

    std::unordered_map<std::wstring, Folder> mFolders;
    const std::pair<const std::wstring, Folder>* mLast = nullptr;
    std::string mBytes;
    CStdStr mResolved;
};
} // namespace

LinkResolver MakeLinkResolver()
{
    const auto folders = std::make_shared<FolderByFolder>();
    return [folders](const CStdStr& path) -> const CStdStr& { return folders->Resolve(path); };
}
} // namespace ModrigPlatform
