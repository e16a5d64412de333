// The host's own commands, by subject. Each function adds its commands to the parts' command stack; they work
// on those parts.
#pragma once

#include <filesystem>
#include <functional>

#include "host/text/Result.h"

namespace tessel
{
struct Parts;

// What only the session can do.
struct SessionActions
{
    std::function<void()> quit;
    std::function<Result<>(const std::filesystem::path&)> runScript;
};

void addSessionCommands(Parts& parts, SessionActions actions); // HELP QUIT EXIT VERSION CD SCRIPT
void addApplicationCommands(Parts& parts);                     // LOAD UNLOAD APPS
void addKeptOutCommands(Parts& parts);                         // DISABLE ENABLE BISECT
void addSettingCommands(Parts& parts);                         // SETVAR PROFILE
void addRegistryCommands(Parts& parts);                        // REGISTRY
} // namespace tessel
