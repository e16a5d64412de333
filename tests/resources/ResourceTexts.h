// The string table of a resource module, read by the reader of the host.
#pragma once

#include <filesystem>
#include <map>
#include <string>
#include <vector>

// The texts of a language by their ids.
struct ResourceTexts
{
    unsigned language;
    std::map<unsigned, std::wstring> texts;
};

// Every language, as they stand in the file. Throws std::runtime_error for one that the host could not use.
std::vector<ResourceTexts> readResourceTexts(const std::filesystem::path& module);
