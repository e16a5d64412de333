#include "tests/support/recording/RecordingFiles.h"

#include <tessel/tsed.h>

#include <filesystem>

#include "host/text/Unicode.h"
#include "tests/support/RecordingHost.h"

namespace
{
DWORD realAttributes(const std::wstring& path)
{
    std::error_code error;
    const auto status = std::filesystem::status(tessel::toUtf8(path), error);
    if (error || !std::filesystem::exists(status))
        return INVALID_FILE_ATTRIBUTES;
    const bool writable =
        (status.permissions() & std::filesystem::perms::owner_write) != std::filesystem::perms::none;
    const DWORD other = std::filesystem::is_other(status) ? FILE_ATTRIBUTE_DEVICE : 0;
    const DWORD kind = std::filesystem::is_directory(status) ? FILE_ATTRIBUTE_DIRECTORY : other;
    const DWORD all = kind | (writable ? 0 : FILE_ATTRIBUTE_READONLY);
    return all ? all : FILE_ATTRIBUTE_NORMAL;
}

bool isFullPath(const std::wstring& path)
{
    return path.starts_with(L"/");
}
} // namespace

void RecordingFiles::addFile(const std::wstring& path, DWORD fileAttributes)
{
    mFiles[fullPath(path)] = fileAttributes;
}

DWORD RecordingFiles::attributes(const std::wstring& path) const
{
    if (mReal)
        return realAttributes(path);
    const auto file = mFiles.find(fullPath(path));
    return file == mFiles.end() ? INVALID_FILE_ATTRIBUTES : file->second;
}

std::wstring RecordingFiles::currentFolderNow() const
{
    return mReal ? tessel::toWide(std::filesystem::current_path().string()) : currentFolder;
}

std::wstring RecordingFiles::search(const std::wstring& name) const
{
    if (const auto told = found.find(name); told != found.end())
        return told->second;
    if (isFullPath(name))
        return attributes(name) == INVALID_FILE_ATTRIBUTES ? std::wstring() : name;
    std::vector<std::wstring> folders = searchFolders;
    folders.insert(folders.begin(), currentFolderNow());
    for (const std::wstring& folder : folders)
        if (const std::wstring path = std::wstring(folder).append(L"/").append(name);
            attributes(path) != INVALID_FILE_ATTRIBUTES)
            return path;
    return {};
}

std::wstring RecordingFiles::fullPath(const std::wstring& path) const
{
    return isFullPath(path) ? path : currentFolder + L"/" + path;
}

DWORD GetFileAttributesW(const wchar_t* path)
{
    RecordingHost& host = recordingHost();
    host.journal.add(L"GetFileAttributesW", {path});
    host.files.attributesAsked.emplace_back(path);
    return host.files.attributes(path);
}

DWORD GetCurrentDirectory(DWORD capacity, wchar_t* buffer)
{
    recordingHost().journal.add(L"GetCurrentDirectory", {capacity});
    const std::wstring folder = recordingHost().files.currentFolderNow();
    const DWORD length = static_cast<DWORD>(folder.size());
    return folder.empty() || copyText(folder, buffer, capacity) ? length : length + 1;
}

int tsedFindFile(const wchar_t* name, wchar_t* found, std::size_t capacity)
{
    RecordingHost& host = recordingHost();
    host.journal.add(L"tsedFindFile", {name});
    host.files.searched.emplace_back(name);
    const std::wstring path = host.files.search(name);
    return !path.empty() && copyText(path, found, capacity) ? TS_NORMAL : TS_ERROR;
}

// There is no home folder here.
int tsedTypedPath(const wchar_t* typed, wchar_t* path, std::size_t capacity)
{
    const std::filesystem::path folder = tessel::toUtf8(recordingHost().files.currentFolderNow());
    std::string whole = (folder / tessel::toUtf8(typed)).lexically_normal().string();
    if (whole.ends_with('/') && whole != "/")
        whole.pop_back();
    return *typed && copyText(tessel::toWide(whole), path, capacity) ? TS_NORMAL : TS_ERROR;
}
