// One download, with limits.
#pragma once

#include <filesystem>
#include <string>

#include "host/files/RemoteFiles.h"
#include "host/text/Result.h"

namespace tessel
{
// Fetches the URL into the file, which appears only when all of it is there. Why not is the end of a
// sentence.
Result<> download(const std::string& url, const std::filesystem::path& file,
                  const RemoteFiles::Limits& limits);
} // namespace tessel
