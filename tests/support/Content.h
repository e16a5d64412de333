// What stands in a file.
#pragma once

#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>

inline std::string contentOf(const std::filesystem::path& file)
{
    std::ifstream stream(file, std::ios::binary);
    return {std::istreambuf_iterator<char>(stream), {}};
}
