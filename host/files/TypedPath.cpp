#include "host/files/TypedPath.h"

#include <tessel/tsed.h>

#include <system_error>

#include "host/platform/HomeFolder.h"
#include "host/text/CallersBuffer.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
std::filesystem::path folderAbove(const std::filesystem::path& folder)
{
    std::error_code unreachable;
    if (!std::filesystem::is_symlink(folder, unreachable))
        return folder.parent_path();
    const auto target = std::filesystem::canonical(folder, unreachable);
    return unreachable ? folder.parent_path() : target.parent_path();
}

std::filesystem::path tidied(const std::filesystem::path& fromRoot)
{
    std::filesystem::path tidy = "/";
    for (const auto& part : fromRoot.relative_path())
        if (part == "..")
            tidy = folderAbove(tidy);
        else if (!part.empty() && part != ".")
            tidy /= part;
    return tidy;
}
} // namespace

std::filesystem::path withTilde(const std::filesystem::path& typed)
{
    std::error_code unreachable;
    return std::filesystem::exists(typed, unreachable)
               ? typed
               : std::filesystem::path(withHomeFolder(typed.native()));
}

std::optional<std::filesystem::path> wholePath(const std::filesystem::path& typed)
{
    const auto meant = withTilde(typed);
    if (meant.is_absolute())
        return tidied(meant);
    std::error_code gone;
    const auto folder = std::filesystem::current_path(gone);
    return gone ? std::nullopt : std::optional(tidied(folder / meant));
}
} // namespace tessel

int tsedTypedPath(const wchar_t* typed, wchar_t* path, std::size_t capacity)
{
    if (!typed || !*typed || !path)
        return TS_ERROR;
    const auto whole = tessel::wholePath(tessel::toUtf8(typed));
    const std::wstring text = whole ? tessel::toWide(whole->native()) : std::wstring();
    return !text.empty() && tessel::copyWhole(text, path, capacity) ? TS_NORMAL : TS_ERROR;
}
