#include <sys/stat.h>
#include <unistd.h>
#include <wincompat/winfile.h>

#include <filesystem>
#include <system_error>

#include "host/text/CallersBuffer.h"
#include "host/text/Unicode.h"

DWORD GetFileAttributesW(const wchar_t* path)
{
    struct stat status = {};
    if (!path || !*path || stat(tessel::toUtf8(path).c_str(), &status) != 0)
        return INVALID_FILE_ATTRIBUTES;
    const DWORD folderOrOther = S_ISDIR(status.st_mode) ? FILE_ATTRIBUTE_DIRECTORY : FILE_ATTRIBUTE_DEVICE;
    DWORD attributes = S_ISREG(status.st_mode) ? 0 : folderOrOther;
    constexpr mode_t kAnyoneMayWrite = S_IWUSR | S_IWGRP | S_IWOTH;
    if ((status.st_mode & kAnyoneMayWrite) == 0)
        attributes |= FILE_ATTRIBUTE_READONLY;
    return attributes ? attributes : FILE_ATTRIBUTE_NORMAL;
}

DWORD GetCurrentDirectory(DWORD capacity, wchar_t* buffer)
{
    std::error_code failed;
    const std::wstring folder = tessel::toWide(std::filesystem::current_path(failed).string());
    if (failed)
        return 0;
    const bool copied = buffer && tessel::copyWhole(folder, buffer, capacity);
    return static_cast<DWORD>(copied ? folder.size() : folder.size() + 1);
}
