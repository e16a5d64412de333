// The ways to load compiled modules that are compared: the module's loader, the host's linker under it, the
// bare calls of the system, and the module loaders of toolkits.
#pragma once

#include <string>
#include <vector>

namespace bench
{
using Paths = std::vector<std::string>;

struct Loader
{
    const char* name;
    // Each answers seconds, negative when not all of the modules came or went. The second loads them first,
    // and is null where unloading is not compared.
    double (*secondsToLoad)(const Paths& modules);
    double (*secondsToUnload)(const Paths& modules);
};

inline constexpr const char* kBare = "bare dlopen and entry";
inline constexpr const char* kGModule = "GModule";
inline constexpr const char* kQLibrary = "QLibrary";
inline constexpr const char* kLibltdl = "libltdl";
inline constexpr const char* kHostLinker = "host linker";
inline constexpr const char* kPerformModrig = "PerformModrig";

const std::vector<Loader>& loaders();
} // namespace bench
