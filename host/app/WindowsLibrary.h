// The library of the host's windows, which carries the toolkit: functions in it are found by their names.
#pragma once

#include <filesystem>

#include <dlfcn.h>

namespace tessel
{
inline constexpr char kWindowsLibrary[] = TESSEL_WINDOWS_LIBRARY; // the file's name on this platform

// Null when it cannot be found. Kept loaded to the end: a toolkit cannot be taken out of a process. With
// `RTLD_NOLOAD` nothing is loaded, and nothing found in what is not loaded yet.
template <typename Function>
Function findWindowsFunction(const std::filesystem::path& folder, const char* name, int howToLoad = 0)
{
    void* windows = dlopen((folder / kWindowsLibrary).c_str(), RTLD_NOW | RTLD_LOCAL | howToLoad);
    return windows ? reinterpret_cast<Function>(dlsym(windows, name)) : nullptr;
}
} // namespace tessel
