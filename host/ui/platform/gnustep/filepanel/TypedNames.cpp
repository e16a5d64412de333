#include "host/ui/platform/gnustep/filepanel/TypedNames.h"

#include <algorithm>
#include <filesystem>

#include "host/ui/platform/gnustep/filepanel/Listing.h"

namespace tessel::filepanel
{
namespace
{
constexpr char kQuote = '"';

// What leads to a folder ends with a slash; the folder itself does not.
std::string withoutEndingSlash(std::string path)
{
    while (path.size() > 1 && path.ends_with('/'))
        path.pop_back();
    return path;
}

std::string withHome(const std::string& name, const std::string& home)
{
    if (name == "~" || name.starts_with("~/"))
        return home + name.substr(1);
    return name;
}
} // namespace

std::vector<std::string> typedNames(const std::string& text)
{
    if (!text.starts_with(kQuote))
        return text.empty() ? std::vector<std::string>() : std::vector<std::string>{text};
    std::vector<std::string> names;
    for (std::size_t open = 0; open != std::string::npos;)
    {
        const std::size_t close = std::min(text.find(kQuote, open + 1), text.size());
        if (close > open + 1)
            names.push_back(text.substr(open + 1, close - open - 1));
        open = text.find(kQuote, std::min(close + 1, text.size()));
    }
    return names;
}

std::string fieldText(const std::vector<std::string>& names)
{
    if (names.size() == 1)
        return names.front();
    std::string text;
    for (const std::string& name : names)
        text += (text.empty() ? "" : " ") + (kQuote + name + kQuote);
    return text;
}

std::string typedPath(const std::string& name, const std::string& folder, const std::string& home)
{
    // A path that is not relative takes the place of the folder.
    const auto whole = std::filesystem::path(folder) / withHome(name, home);
    return withoutEndingSlash(whole.lexically_normal().string());
}

TypedStart typedStart(const std::string& text)
{
    const std::size_t slash = text.rfind('/');
    if (slash == std::string::npos)
        return {"", text};
    return {text.substr(0, slash + 1), text.substr(slash + 1)};
}

std::string completed(const std::string& beginning, const std::vector<std::string>& names)
{
    if (beginning.empty() || std::ranges::find(names, beginning) != names.end())
        return "";
    const auto same =
        std::ranges::find_if(names, [&](const std::string& name) { return name.starts_with(beginning); });
    if (same != names.end())
        return *same;
    const auto alike =
        std::ranges::find_if(names, [&](const std::string& name) { return beginsLike(name, beginning); });
    return alike != names.end() ? *alike : "";
}
} // namespace tessel::filepanel
