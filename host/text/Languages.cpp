#include "host/text/Languages.h"

#include <algorithm>
#include <cstdlib>
#include <string_view>

namespace tessel
{
namespace
{
std::string_view variable(const char* name)
{
    const char* value = std::getenv(name);
    return value ? value : "";
}

// "de_AT.UTF-8@euro" is "de_AT".
std::string_view withoutEncoding(std::string_view locale)
{
    return locale.substr(0, locale.find_first_of(".@"));
}

std::string_view localeOfMessages()
{
    for (const char* name : {"LC_ALL", "LC_MESSAGES", "LANG"})
        if (const auto locale = withoutEncoding(variable(name)); !locale.empty())
            return locale;
    return "C";
}

void add(std::vector<std::string>& languages, std::string_view language)
{
    if (!language.empty() && std::ranges::find(languages, language) == languages.end())
        languages.emplace_back(language);
}

void addWithItsParent(std::vector<std::string>& languages, std::string_view locale)
{
    const std::string_view language = withoutEncoding(locale);
    add(languages, language);
    add(languages, language.substr(0, language.find('_')));
}
} // namespace

std::vector<std::string> personsLanguages()
{
    const std::string_view locale = localeOfMessages();
    if (locale == "C" || locale == "POSIX")
        return {};
    std::vector<std::string> languages;
    std::string_view rest = variable("LANGUAGE");
    while (!rest.empty())
    {
        const std::size_t end = std::min(rest.find(':'), rest.size());
        addWithItsParent(languages, rest.substr(0, end));
        rest.remove_prefix(std::min(end + 1, rest.size()));
    }
    addWithItsParent(languages, locale);
    return languages;
}
} // namespace tessel
