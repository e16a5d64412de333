// The real host in the benchmark's process, with a throwaway profile.
#pragma once

#include <filesystem>

namespace bench
{
// A folder of the run, removed at its end.
const std::filesystem::path& workFolder();

// Starts the host, once, without applications.
void startHost();

// What the host does at the end of a command: stores what was written.
void endCommand();
} // namespace bench
