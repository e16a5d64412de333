#include "host/app/Options.h"

#include <filesystem>
#include <sstream>
#include <system_error>

#include <CLI/CLI.hpp>

#include "host/text/Unicode.h"
#include "host/text/Version.h"

namespace tessel
{
namespace
{
constexpr char kAfterword[] =
    "Tessel loads the files first. With --script or -c it runs the script, then the commands, and ends: "
    "with\n"
    "status 0, or with 1 if a file could not be loaded, a command was unknown or failed or a Lisp "
    "expression\n"
    "had an error. Otherwise it reads commands from the terminal, or line by line from a pipe, which is\n"
    "treated like a script. What goes wrong is said on standard error. Wrong arguments end with status 2.";

std::string isNamed(const std::string& folder)
{
    return folder.empty() ? "a folder is wanted, and nothing is named" : "";
}

std::string isNamedFile(const std::string& file)
{
    return file.empty() ? "a file is wanted, and nothing is named" : "";
}

// A layout that is to be tried and is not there would not be missed.
std::string isThere(const std::string& folder)
{
    std::error_code unreachable;
    return std::filesystem::is_directory(folder, unreachable) ? "" : folder + " is no folder";
}

void declare(CLI::App& app, Options& options)
{
    app.footer(kAfterword);
    app.set_help_flag("-h,--help", "Show this text and end");
    app.set_version_flag("--version", versionLine(), "Show the version and end");
    app.add_option("--profile-dir", options.profileFolder,
                   "Keep everything in this folder instead of your own")
        ->type_name("DIR")
        ->check(isNamed);
    app.add_option("--layout-dir", options.layoutFolder,
                   "Take the values for everybody in this folder, too, to try them")
        ->type_name("DIR")
        ->check(isNamed)
        ->check(isThere);
    auto* script =
        app.add_option("--script", options.script, "Run the commands in a file")->type_name("SCRIPT");
    // One argument each, so that a command may begin with a dash and a file name may follow.
    auto* command = app.add_option("-c,--command", options.commands,
                                   "Run a command or a Lisp expression (may be repeated)")
                        ->type_name("COMMAND")
                        ->expected(1)
                        ->multi_option_policy(CLI::MultiOptionPolicy::TakeAll)
                        ->allow_extra_args(false);
    app.add_option("FILE", options.files, "Load applications, as LOAD does")->type_name("");
    auto* quiet = app.add_flag_callback(
        "-q,--quiet", [&options] { options.loudness = Loudness::kQuiet; },
        "Say only what is asked for and what goes wrong");
    app.add_flag_callback(
           "-v,--verbose", [&options] { options.loudness = Loudness::kTalkative; },
           "Say also what is done: files looked at, time taken")
        ->excludes(quiet);
    app.add_option("--log", options.log, "Add everything that is said to a file, with times")
        ->type_name("LOGFILE")
        ->check(isNamedFile);
    app.add_flag("--modrig", options.modrig, "Open Modrig's dialog, and end with it")
        ->excludes(script)
        ->excludes(command);
    app.add_flag("--safe", options.safe, "Start without loading any application by itself");
}
} // namespace

Result<ParsedOptions> parseOptions(int count, const char* const* arguments)
{
    Options options;
    CLI::App app("Tessel R21, the reference host for Modrig.", "Tessel");
    declare(app, options);
    try
    {
        app.parse(count, arguments);
        return ParsedOptions{options, {}};
    }
    catch (const CLI::ParseError& outcome)
    {
        std::ostringstream text;
        const bool failed = app.exit(outcome, text, text) != 0;
        if (failed)
            return Failure{toWide(text.str()), kWrongArguments};
        return ParsedOptions{std::nullopt, text.str()};
    }
}
} // namespace tessel
