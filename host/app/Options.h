// What the program was started with.
#pragma once

#include <filesystem>
#include <optional>
#include <string>
#include <vector>

#include "host/text/CommandLine.h"
#include "host/text/Result.h"

namespace tessel
{
struct Options
{
    std::filesystem::path profileFolder; // empty: the person's own
    std::filesystem::path layoutFolder;  // of values for everybody, to try them; empty: none
    std::filesystem::path script;        // empty: none
    std::vector<std::string> commands;   // -c, in their order; UTF-8
    std::vector<std::string> files;      // to be loaded first, as LOAD does, in their order
    bool safe = false;                   // start without loading any application by itself
    std::filesystem::path log;           // of everything that is said; empty: none
    Loudness loudness = Loudness::kUsual;
    bool modrig = false; // show Modrig's dialog, and nothing else

    // Whether the host ends after the script and the commands, or the dialog, instead of asking for more.
    bool isBatch() const { return !script.empty() || !commands.empty() || modrig; }
};

// What the arguments ask for: a session with these options, or else a text to print.
struct ParsedOptions
{
    std::optional<Options> options;
    std::string text;
};

// The code of a failure, and the status to end with.
inline constexpr int kWrongArguments = 2;

// Fails with whole lines that say what is wrong and repeat what was typed.
Result<ParsedOptions> parseOptions(int count, const char* const* arguments);
} // namespace tessel
