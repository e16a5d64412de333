// The host's own commands, by subject. Each function adds its commands to the stack; they work on the parts
// of the running host.
#pragma once

#include <filesystem>
#include <functional>

#include "host/text/Result.h"

namespace tessel
{
class CommandStack;

// What only the session can do.
struct SessionActions
{
    std::function<void()> quit;
    std::function<Result<>(const std::filesystem::path&)> runScript;
};

void addSessionCommands(CommandStack& commands, SessionActions actions); // HELP QUIT EXIT VERSION CD SCRIPT
void addApplicationCommands(CommandStack& commands);                     // LOAD UNLOAD APPS
void addSettingCommands(CommandStack& commands);                         // SETVAR PROFILE
void addRegistryCommands(CommandStack& commands);                        // REGISTRY
} // namespace tessel
