// The real host in the benchmark's process, with a throwaway profile.
#pragma once

#include <filesystem>
#include <string>

namespace bench
{
// A folder of the run, removed at its end.
const std::filesystem::path& workFolder();

// Starts the host, once, without applications.
void startHost();

// Makes the profile the current one, in a command of its own.
void useProfile(const std::wstring& name);

// What the host does at the end of a command: stores what was written.
void endCommand();
} // namespace bench
