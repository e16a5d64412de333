// One download, with limits.
#pragma once

#include <filesystem>
#include <string>

#include "host/files/RemoteFiles.h"

namespace tessel
{
// Fetches the URL into the file, which appears only when all of it is there. Empty, or why not in the
// library's words.
std::string download(const std::string& url, const std::filesystem::path& file,
                     const RemoteFiles::Limits& limits);
} // namespace tessel
