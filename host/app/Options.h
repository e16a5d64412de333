// What the program was started with.
#pragma once

#include <filesystem>
#include <optional>
#include <string>
#include <vector>

namespace tessel
{
struct Options
{
    std::filesystem::path profileFolder; // empty: the person's own
    std::filesystem::path script;        // empty: none
    std::vector<std::string> commands;   // -c, in their order; UTF-8
    bool safe = false;                   // start without loading any application by itself

    // Whether the host ends after the script and the commands instead of asking for more.
    bool isBatch() const { return !script.empty() || !commands.empty(); }
};

// The outcome of reading the arguments: options, or a text to print and the status to end with.
struct ParsedOptions
{
    std::optional<Options> options;
    std::string text;
    int exitStatus = 0;
};

ParsedOptions parseOptions(int count, const char* const* arguments);
} // namespace tessel
