// The string table of a resource module, read by the reader of the host.
#pragma once

#include <filesystem>
#include <map>
#include <string>

// Every text by its id. Throws std::runtime_error for a file that the host could not use.
std::map<unsigned, std::wstring> readResourceTexts(const std::filesystem::path& module);
