#include "host/files/FileSearch.h"

#include <tessel/tsed.h>

#include <algorithm>
#include <string_view>
#include <system_error>

#include "host/registry/SystemVariables.h"
#include "host/text/CallersBuffer.h"
#include "host/text/Running.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr char kPathSeparator = ';';

bool isThere(const std::filesystem::path& path)
{
    std::error_code unreachable; // is as good as not there
    return std::filesystem::exists(path, unreachable);
}

// None while the current folder is one that was removed: there is no path to it, nor to what ".." finds from
// it.
std::optional<std::filesystem::path> absolutePath(const std::filesystem::path& path)
{
    std::error_code gone;
    const auto absolute = std::filesystem::absolute(path, gone);
    return gone ? std::nullopt : std::optional(absolute.lexically_normal());
}
} // namespace

FileSearch::FileSearch(std::filesystem::path hostFolder, const SystemVariables& variables)
    : mHostFolder(std::move(hostFolder)), mVariables(variables)
{
}

std::vector<std::filesystem::path> FileSearch::folders() const
{
    std::error_code gone; // a current folder that was removed is passed over
    std::vector<std::filesystem::path> folders = {std::filesystem::current_path(gone), mHostFolder};
    const std::string listed = toUtf8(mVariables.text(kSearchPath));
    std::string_view rest = listed;
    while (!rest.empty())
    {
        const std::size_t end = std::min(rest.find(kPathSeparator), rest.size());
        folders.emplace_back(rest.substr(0, end));
        rest.remove_prefix(std::min(end + 1, rest.size()));
    }
    return folders;
}

std::optional<std::filesystem::path> FileSearch::find(const std::filesystem::path& name) const
{
    if (name.empty())
        return std::nullopt;
    if (name.is_absolute())
        return isThere(name) ? std::optional(name) : std::nullopt;
    for (const std::filesystem::path& folder : folders())
        if (!folder.empty() && isThere(folder / name))
            if (auto path = absolutePath(folder / name))
                return path;
    return std::nullopt;
}
} // namespace tessel

int tsedFindFile(const wchar_t* name, wchar_t* found, std::size_t capacity)
{
    const tessel::FileSearch* files = tessel::running<tessel::FileSearch>();
    if (!files || !name || !found)
        return TS_ERROR;
    const auto path = files->find(tessel::toUtf8(name));
    const std::wstring text = path ? tessel::toWide(path->string()) : std::wstring();
    return !text.empty() && tessel::copyWhole(text, found, capacity) ? TS_NORMAL : TS_ERROR;
}
