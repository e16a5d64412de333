// A localized string table as the platform reads it.
#pragma once

#include <filesystem>
#include <map>
#include <optional>
#include <string>

// The texts by key, both UTF-8; nothing when the file is missing or is no string table.
std::optional<std::map<std::string, std::string>> readStringsFile(const std::filesystem::path& file);
