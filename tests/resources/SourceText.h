// What the sources of the product say, for tests that compare them with its texts.
#pragma once

#include <filesystem>
#include <string>

// The root of the source tree.
std::filesystem::path sourceRoot();

std::string readFile(const std::filesystem::path& file);

// The code of the module, all its files one after the other.
std::string moduleSources();
