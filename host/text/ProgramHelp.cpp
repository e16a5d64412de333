#include "host/text/ProgramHelp.h"

#include <string>

#include <CLI/CLI.hpp>

#include "host/text/Translation.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
std::wstring before(const std::wstring& words, std::wstring_view mark)
{
    return words.substr(0, words.find(mark));
}

std::wstring after(const std::wstring& words, std::wstring_view mark)
{
    const std::size_t at = words.find(mark);
    return at == words.npos ? words : words.substr(at + mark.size());
}

// What was wrong is told by what is thrown; only its words name the arguments.
std::wstring whatIsWrong(const CLI::Error& error)
{
    const std::wstring words = toWide(error.what());
    if (dynamic_cast<const CLI::ExtrasError*>(&error))
        return words.starts_with(L"The following arguments")
                   ? translated(L"There are no such arguments: {}", after(words, L": "))
                   : translated(L"There is no such argument: {}", after(words, L": "));
    if (dynamic_cast<const CLI::ExcludesError*>(&error))
        return translated(L"{} and {} cannot be given together.", before(words, L" excludes "),
                          after(words, L" excludes "));
    if (dynamic_cast<const CLI::RequiredError*>(&error))
        return translated(L"{} is missing.", before(words, L" is required"));
    if (!dynamic_cast<const CLI::ArgumentMismatch*>(&error))
        return words;
    return words.ends_with(L" missing")
               ? translated(L"Something is missing after {}: {}", before(words, L":"),
                            before(after(words, L" required "), L" missing"))
               : translated(L"{} takes no value.", L"--" + before(words, L" was given"));
}
} // namespace

void translateHelp(CLI::App& app)
{
    auto& words = *app.get_formatter();
    words.label("Usage", translatedInUtf8(L"Usage"));
    words.label("OPTIONS", translatedInUtf8(L"OPTIONS"));
    words.label("Positionals", translatedInUtf8(L"Positionals"));
    words.label("REQUIRED", translatedInUtf8(L"REQUIRED"));
    words.label("TEXT", translatedInUtf8(L"TEXT"));
    words.label("Excludes", translatedInUtf8(L"Excludes"));
    constexpr auto kHelp =
        Sentence(L"Print this help message and exit"); // unless the program has its own words
    if (toWide(app.get_help_ptr()->get_description()) == kHelp.english)
        app.get_help_ptr()->description(translatedInUtf8(kHelp));
    for (CLI::Option* option : app.get_options())
        if (option->get_group() == "Options")
            option->group(translatedInUtf8(L"Options"));
    app.failure_message(
        [](const CLI::App*, const CLI::Error& error)
        { return toUtf8(whatIsWrong(error) + L"\n" + translated(L"--help tells more.") + L"\n"); });
}
} // namespace tessel
