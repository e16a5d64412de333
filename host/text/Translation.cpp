#include "host/text/Translation.h"

#include <exception>
#include <locale>
#include <optional>
#include <system_error>

#include <boost/locale/gnu_gettext.hpp>

namespace tessel
{
namespace
{
namespace catalogues = boost::locale::gnu_gettext;
// Of bytes: a wide one would convert every sentence when it is read.
using Catalogue = boost::locale::message_format<char>;

constexpr char kCatalogue[] = "tessel";
constexpr int kOnlyDomain = 0;

// The locale that holds the catalogue in use; one without, to begin with.
std::locale& holder()
{
    static std::locale theHolder = std::locale::classic();
    return theHolder;
}

const Catalogue* catalogueInUse()
{
    return std::has_facet<Catalogue>(holder()) ? &std::use_facet<Catalogue>(holder()) : nullptr;
}

bool hasCatalogue(const std::filesystem::path& folder, const std::string& language)
{
    const auto file = folder / language / "LC_MESSAGES" / (std::string(kCatalogue) + ".mo");
    std::error_code error;
    return std::filesystem::exists(file, error);
}

std::optional<std::locale> readCatalogue(const std::filesystem::path& folder, const std::string& language)
{
    catalogues::messages_info wanted;
    wanted.language = language;
    wanted.encoding = "UTF-8";
    wanted.paths = {folder.string()};
    wanted.domains = {catalogues::messages_info::domain(kCatalogue)};
    try
    {
        return std::locale(std::locale::classic(), catalogues::create_messages_facet<char>(wanted));
    }
    catch (const std::exception&) // a damaged one is as good as none
    {
        return {};
    }
}

bool isEnglish(const std::string& language)
{
    return language == "en" || language.starts_with("en_");
}

std::wstring fill(std::wstring_view text, std::initializer_list<std::wstring> things)
{
    std::wstring filled;
    const auto* next = things.begin();
    while (!text.empty())
    {
        const Place place = Place::at(text);
        if (place.length == 0)
            filled += text.front();
        else
            filled += place.number > 0 ? things.begin()[place.number - 1] : *next++;
        text.remove_prefix(place.length > 0 ? place.length : 1);
    }
    return filled;
}

std::wstring fillEither(const char* translation, const wchar_t* english,
                        std::initializer_list<std::wstring> things)
{
    const std::wstring translated = toWide(translation ? translation : "");
    if (translation && hasPlacesFor(things.size(), translated))
        return fill(translated, things);
    return hasPlacesFor(things.size(), english) ? fill(english, things) : english;
}
} // namespace

void useTranslations(const std::filesystem::path& folder, const std::vector<std::string>& languages)
{
    holder() = std::locale::classic();
    for (const auto& language : languages)
    {
        const auto catalogue =
            hasCatalogue(folder, language) ? readCatalogue(folder, language) : std::optional<std::locale>();
        if (catalogue)
            holder() = *catalogue;
        if (catalogue || isEnglish(language))
            return;
    }
}

std::wstring translateAndFill(const wchar_t* english, std::initializer_list<std::wstring> things)
{
    // Of an empty text a catalogue has its own head.
    const Catalogue* catalogue = *english == L'\0' ? nullptr : catalogueInUse();
    return fillEither(catalogue ? catalogue->get(kOnlyDomain, nullptr, toUtf8(english).c_str()) : nullptr,
                      english, things);
}

std::wstring translateAndFill(const wchar_t* one, const wchar_t* several, std::size_t count,
                              std::initializer_list<std::wstring> things)
{
    const Catalogue* catalogue = catalogueInUse();
    const char* translation =
        catalogue ? catalogue->get(kOnlyDomain, nullptr, toUtf8(one).c_str(), static_cast<int>(count))
                  : nullptr;
    return fillEither(translation, count == 1 ? one : several, things);
}
} // namespace tessel
