// Folders and the ways to them.
#pragma once

#include <string>
#include <vector>

namespace tessel::filepanel
{
inline constexpr std::size_t kMostRecentFolders = 10;

// A folder on the way to another one, and what is written on its button.
struct Step
{
    std::string title;
    std::string path;
};

// Whether a folder stands there, links followed.
bool isFolder(const std::string& path);

// The way from the root to the folder itself.
std::vector<Step> wayTo(const std::string& folder);

// Which steps of a row have to be left out, from the first, so that the others fit.
std::size_t stepsThatDoNotFit(const std::vector<double>& widths, double available);

// The folder, or the nearest on the way to it that exists.
std::string nearestFolder(const std::string& path);

// The folder above; the root is its own.
std::string folderAbove(const std::string& folder);

// The folders used last, the last one first and each once.
std::vector<std::string> withRecentFolder(std::vector<std::string> folders, const std::string& folder);
} // namespace tessel::filepanel
