// Key paths, whose parts are separated by one backslash. Empty parts are passed over by who looks at them.
#pragma once

#include <algorithm>
#include <string_view>

namespace tessel
{
// The first part, which the path then lacks, with its separator.
inline std::wstring_view takeKeyPart(std::wstring_view& path)
{
    const std::size_t end = std::min(path.find(L'\\'), path.size());
    const std::wstring_view part = path.substr(0, end);
    path.remove_prefix(std::min(end + 1, path.size()));
    return part;
}
} // namespace tessel
