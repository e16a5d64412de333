#include "host/text/ProgramHelp.h"

#include <string>

#include <CLI/CLI.hpp>

#include "host/text/Translation.h"
#include "host/text/Unicode.h"

namespace tessel
{
void translateHelp(CLI::App& app)
{
    auto& words = *app.get_formatter();
    words.label("Usage", toUtf8(translated(L"Usage")));
    words.label("OPTIONS", toUtf8(translated(L"OPTIONS")));
    words.label("Positionals", toUtf8(translated(L"Positionals")));
    words.label("REQUIRED", toUtf8(translated(L"REQUIRED")));
    words.label("TEXT", toUtf8(translated(L"TEXT")));
    words.label("Excludes", toUtf8(translated(L"Excludes")));
    constexpr auto kHelp =
        Sentence(L"Print this help message and exit"); // unless the program has its own words
    if (toWide(app.get_help_ptr()->get_description()) == kHelp.english)
        app.get_help_ptr()->description(toUtf8(translated(kHelp)));
    for (CLI::Option* option : app.get_options())
        if (option->get_group() == "Options")
            option->group(toUtf8(translated(L"Options")));
}
} // namespace tessel
