#include "host/app/Options.h"

#include <filesystem>
#include <sstream>
#include <system_error>

#include <CLI/CLI.hpp>

#include "host/text/ProgramHelp.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"
#include "host/text/Version.h"

namespace tessel
{
namespace
{
constexpr auto kAfterword =
    Sentence(L"Tessel loads the files first. With --script or -c it runs the script, then the commands, and "
             L"ends: with\nstatus 0, or with 1 if a file could not be loaded, a command was unknown or "
             L"failed or a Lisp expression\nhad an error. Otherwise it reads commands from the terminal, or "
             L"line by line from a pipe, which is\ntreated like a script. What goes wrong is said on "
             L"standard error. Wrong arguments end with status 2.");

std::string isNamed(const std::string& folder)
{
    return folder.empty() ? translatedInUtf8(L"a folder is wanted, and nothing is named") : std::string();
}

std::string isNamedFile(const std::string& file)
{
    return file.empty() ? translatedInUtf8(L"a file is wanted, and nothing is named") : std::string();
}

// A layout that is to be tried and is not there would not be missed.
std::string isThere(const std::string& folder)
{
    std::error_code unreachable;
    return std::filesystem::is_directory(folder, unreachable)
               ? ""
               : toUtf8(translated(L"{} is no folder", toWide(folder)));
}

void declare(CLI::App& app, Options& options)
{
    app.footer(translatedInUtf8(kAfterword));
    app.option_defaults()->disable_flag_override(); // --safe=3 would be --safe, and --safe=no nothing
    app.set_help_flag("-h,--help", translatedInUtf8(L"Show this text and end"));
    app.set_version_flag("--version", versionLine(), translatedInUtf8(L"Show the version and end"));
    app.add_option("--profile-dir", options.profileFolder,
                   translatedInUtf8(L"Keep everything in this folder instead of your own"))
        ->type_name(translatedInUtf8(L"DIR"))
        ->check(isNamed);
    app.add_option("--layout-dir", options.layoutFolder,
                   translatedInUtf8(L"Take the values for everybody in this folder, too, to try them"))
        ->type_name(translatedInUtf8(L"DIR"))
        ->check(isNamed)
        ->check(isThere);
    auto* script = app.add_option("--script", options.script, translatedInUtf8(L"Run the commands in a file"))
                       ->type_name(translatedInUtf8(L"SCRIPT"));
    // One argument each, so that a command may begin with a dash and a file name may follow.
    auto* command = app.add_option("-c,--command", options.commands,
                                   translatedInUtf8(L"Run a command or a Lisp expression (may be repeated)"))
                        ->type_name(translatedInUtf8(L"COMMAND"))
                        ->expected(1)
                        ->multi_option_policy(CLI::MultiOptionPolicy::TakeAll)
                        ->allow_extra_args(false);
    app.add_option(translatedInUtf8(L"FILE"), options.files,
                   translatedInUtf8(L"Load applications, as LOAD does"))
        ->type_name("");
    auto* quiet = app.add_flag_callback(
        "-q,--quiet", [&options] { options.loudness = Loudness::kQuiet; },
        translatedInUtf8(L"Say only what is asked for and what goes wrong"));
    app.add_flag_callback(
           "-v,--verbose", [&options] { options.loudness = Loudness::kTalkative; },
           translatedInUtf8(L"Say also what is done: files looked at, time taken"))
        ->excludes(quiet);
    app.add_option("--log", options.log,
                   translatedInUtf8(L"Add everything that is said to a file, with times"))
        ->type_name(translatedInUtf8(L"LOGFILE"))
        ->check(isNamedFile);
    app.add_flag("--modrig", options.modrig, translatedInUtf8(L"Open Modrig's dialog, and end with it"))
        ->excludes(script)
        ->excludes(command);
    app.add_flag("--safe", options.safe,
                 translatedInUtf8(L"Start without loading any application by itself"));
}
} // namespace

Result<ParsedOptions> parseOptions(int count, const char* const* arguments)
{
    Options options;
    CLI::App app(translatedInUtf8(L"Tessel R21, the reference host for Modrig."), "Tessel");
    declare(app, options);
    translateHelp(app);
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
