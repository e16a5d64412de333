#include "modrig/types/FileValidation.h"

#include <tessel/tsed.h>
#include <tessel/tshostservices.h>
#include <tessel/tsinet.h>
#include <wincompat/winfile.h>

#include <vector>

#include "modrig/base/SplitPath.h"
#include "modrig/messages/MessageIds.h"
#include "modrig/messages/Messages.h"
#include "modrig/types/ApplicationTypes.h"

namespace ModrigUtils
{
namespace
{
constexpr std::size_t kPathSize = 1024;
constexpr int kMostSeparatorsStripped = 1026;

// The names to look for: the file's own, or, without an extension, one for every application kind.
std::vector<CStdStr> CandidateNames(const SplitPath& split)
{
    if (!split.Extension().empty() && split.Extension() != L".")
        return {split.FileName()};
    std::vector<CStdStr> names;
    for (const CExtInfo& row : sExtInfo)
        if (row.mbEnabled)
            names.push_back(CStdStr(split.Name()) + CStdStr(L".") + CStdStr(row.mExtension));
    return names;
}

CStdStr CurrentFolder()
{
    wchar_t folder[kPathSize] = {};
    GetCurrentDirectory(kPathSize, folder); // a folder that does not fit leaves the text empty
    return CStdStr(std::wstring(folder));
}

DWORD FindInCurrentFolder(const std::vector<CStdStr>& names, CStdStr& path)
{
    for (const CStdStr& name : names)
    {
        const DWORD attributes = GetFileAttributesW(name.c_str());
        if (attributes == INVALID_FILE_ATTRIBUTES)
            continue;
        path = CurrentFolder() + CStdStr(L"/") + name;
        return attributes;
    }
    return INVALID_FILE_ATTRIBUTES;
}

DWORD FindOnSearchPath(const std::vector<CStdStr>& names, CStdStr& path)
{
    for (const CStdStr& name : names)
    {
        wchar_t found[kPathSize] = {};
        if (tsedFindFile(name.c_str(), found, kPathSize) != TS_NORMAL)
            continue;
        path = CStdStr(std::wstring(found));
        return GetFileAttributesW(found);
    }
    return INVALID_FILE_ATTRIBUTES;
}

// Takes separators off the end, backslashes before slashes. The number is bounded, so that a path of nothing
// but separators comes to an end.
CStdStr StripClosingSeparators(const CStdStr& path)
{
    std::wstring text = path.Text();
    for (const wchar_t separator : {L'\\', L'/'})
        for (int strips = 0; strips < kMostSeparatorsStripped && text.ends_with(separator); ++strips)
            text.pop_back();
    return CStdStr(text);
}
} // namespace

bool IsValidFileForModrig(const CStdStr& path)
{
    const CStdStr extension = path.AfterLastDot();
    if (!extension.IsEmpty())
        return FindExtension(extension) != nullptr;
    ModrigAfxMessageBox(ModrigMessages::kCannotLoadFile, path);
    return false;
}

DWORD ValidateFileExists(CStdStr& path)
{
    const DWORD attributes = GetFileAttributesW(path.c_str());
    if (attributes != INVALID_FILE_ATTRIBUTES)
        return attributes;
    const SplitPath split(path);
    // Its name is not known then, and must not be taken for an empty one, which other files answer to.
    if (split.IsTooLong())
        return INVALID_FILE_ATTRIBUTES;
    const std::vector<CStdStr> names = CandidateNames(split);
    const DWORD found = FindInCurrentFolder(names, path);
    return found != INVALID_FILE_ATTRIBUTES ? found : FindOnSearchPath(names, path);
}

bool IsTempInternetFile(const CStdStr& path)
{
    const CProxyInet* proxy = CProxyInet::GetProxyInet();
    wchar_t url[kPathSize]; // where it came from does not matter here
    return proxy && proxy->IsRemoteFile(path.c_str(), url, kPathSize);
}

void ValidateURLFile(CStdStr& path, void*)
{
    TsDbHostApplicationServices* services = tsdbHostApplicationServices();
    if (path.IsEmpty() || !services)
        return;
    const CStdStr url = StripClosingSeparators(path);
    if (!services->isUrl(url.c_str()))
        return;
    path = url;
    wchar_t local[kPathSize] = {};
    const int status = services->fetchRemoteFile(url.c_str(), local, kPathSize, false);
    if (status == TS_FETCHED || status == TS_FROM_CACHE)
        path = CStdStr(std::wstring(local));
    else
        ModrigAfxMessageBox(ModrigMessages::kUrlNotFetched, CStdStr());
}
} // namespace ModrigUtils
