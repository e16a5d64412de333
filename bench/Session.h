// The real host in the benchmark's process, with a throwaway profile.
#pragma once

#include <cstddef>
#include <filesystem>
#include <string>

namespace bench
{
// A folder of the run, removed at its end.
const std::filesystem::path& workFolder();

// The folder below it that holds so many copies of the smallest module, made when they are not there yet; and
// the place of each.
std::filesystem::path folderOfModules(const std::string& name, std::size_t count);
std::filesystem::path moduleIn(const std::filesystem::path& folder, std::size_t number);

// The path as the host takes it. Those of the benchmarks hold no other letters than English ones.
std::wstring wide(const std::filesystem::path& path);

// Starts the host, once, without applications.
void startHost();

// Makes the profile the current one, in a command of its own.
void useProfile(const std::wstring& name);

// What the host does at the end of a command: stores what was written.
void endCommand();
} // namespace bench
