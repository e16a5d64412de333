#include "host/ui/platform/gnustep/filepanel/Folders.h"

#include <algorithm>
#include <filesystem>
#include <numeric>

#include <sys/stat.h>

namespace tessel::filepanel
{
bool isFolder(const std::string& path)
{
    struct stat status;
    return stat(path.c_str(), &status) == 0 && S_ISDIR(status.st_mode);
}

std::vector<Step> wayTo(const std::string& folder)
{
    std::vector<Step> steps;
    std::filesystem::path way;
    for (const auto& part : std::filesystem::path(folder))
    {
        way /= part;
        if (!part.empty())
            steps.push_back({part.string(), way.string()});
    }
    return steps;
}

std::size_t stepsThatDoNotFit(const std::vector<double>& widths, double available)
{
    double total = std::accumulate(widths.begin(), widths.end(), 0.0);
    std::size_t leftOut = 0;
    // The folder itself always shows.
    for (; leftOut + 1 < widths.size() && total > available; ++leftOut)
        total -= widths[leftOut];
    return leftOut;
}

std::string nearestFolder(const std::string& path)
{
    std::string folder = path;
    while (!isFolder(folder) && folder != folderAbove(folder))
        folder = folderAbove(folder);
    return folder;
}

std::string folderAbove(const std::string& folder)
{
    const std::size_t slash = folder.find_last_of('/');
    if (slash == std::string::npos || slash == 0)
        return "/";
    return folder.substr(0, slash);
}

std::vector<std::string> withRecentFolder(std::vector<std::string> folders, const std::string& folder)
{
    std::erase(folders, folder);
    folders.insert(folders.begin(), folder);
    folders.resize(std::min(folders.size(), kMostRecentFolders));
    return folders;
}
} // namespace tessel::filepanel
