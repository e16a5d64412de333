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
    app.get_help_ptr()->description(toUtf8(translated(L"Print this help message and exit")));
    for (CLI::Option* option : app.get_options())
        if (option->get_group() == "Options")
            option->group(toUtf8(translated(L"Options")));
}
} // namespace tessel
