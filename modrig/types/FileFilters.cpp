#include "modrig/types/FileFilters.h"

#include <tessel/tshostservices.h>

#include <algorithm>
#include <iterator>
#include <vector>

#include "modrig/messages/MessageIds.h"
#include "modrig/messages/Messages.h"
#include "modrig/profile/ProfileRegistry.h"
#include "modrig/types/ApplicationTypes.h"

namespace ModrigUtils
{
namespace
{
constexpr const wchar_t* kStoredChoice = L"FileFilter";
constexpr const char* kAllApplicationsKey = "IDS_MODRIG_TESSEL_APPS";
constexpr int kHostRelease = 21;

struct FilterEntry
{
    CStdStr description;
    CStdStr patterns; // separated by ";"
};

CStdStr AllApplicationsFilter()
{
    const TsDbHostApplicationServices* services = tsdbHostApplicationServices();
    return CStdStr::Formatted(ModrigMessages::kAllApplicationsFilter, kHostRelease,
                              services ? services->product() : L"");
}

std::vector<CStdStr> FilterTexts()
{
    std::vector<CStdStr> texts = {AllApplicationsFilter()};
    for (const ApplicationKind& kind : KindsByFilter())
        texts.push_back(CStdStr::OfId(kind.filterText));
    return texts;
}

bool IsKnownPattern(std::wstring_view pattern)
{
    constexpr std::wstring_view kAnyName = L"*.";
    if (pattern.starts_with(kAnyName))
        pattern.remove_prefix(kAnyName.size());
    return FindExtension(CStdStr(pattern)) != nullptr;
}

CStdStr KnownPatterns(std::wstring_view patterns)
{
    std::wstring known;
    while (!patterns.empty())
    {
        const std::size_t end = std::min(patterns.find(L';'), patterns.size());
        const std::wstring_view pattern = patterns.substr(0, end);
        patterns.remove_prefix(std::min(end + 1, patterns.size()));
        if (!IsKnownPattern(pattern))
            continue;
        if (!known.empty())
            known += L';';
        known += pattern;
    }
    return CStdStr(known);
}

FilterEntry ParseEntry(const CStdStr& text)
{
    const std::wstring& whole = text.Text();
    const std::size_t bar = std::min(whole.find(L'|'), whole.size());
    return {text.Left(bar), KnownPatterns(text.Mid(bar + 1).Text())};
}

std::vector<FilterEntry> FilterEntries()
{
    std::vector<FilterEntry> entries;
    for (const CStdStr& text : FilterTexts())
        if (!text.IsEmpty())
            entries.push_back(ParseEntry(text));
    return entries;
}

// Nothing chosen is no choice, not even of an entry that describes nothing.
bool IsChosen(const FilterEntry& entry, const CStdStr& choice)
{
    return !choice.IsEmpty() && entry.description.EqualsNoCase(choice);
}
} // namespace

std::vector<const char*> FileFilterKeys()
{
    std::vector<const char*> keys = {kAllApplicationsKey};
    for (const ApplicationKind& kind : KindsByFilter())
        if (kind.filterKey)
            keys.push_back(kind.filterKey);
    return keys;
}

CStdStr GetRegFileFilterListIndex()
{
    CStdStr choice;
    // Nothing remembered and nothing readable are the same to the caller: no choice.
    static_cast<void>(
        ReadModrigRegString(HKEY_CURRENT_USER, GetModrigProfileRegKey(), kStoredChoice, choice));
    return choice;
}

bool SetRegFileFilterListIndex(const CStdStr& filter)
{
    if (WriteModrigRegString(HKEY_CURRENT_USER, GetModrigProfileRegKey(), kStoredChoice, filter))
        return true;
    ModrigAfxMessageBox(ModrigMessages::kFilterNotStored, CStdStr());
    return false;
}

void ReAdjustFilterString(CStdStr& filter)
{
    const CStdStr choice = GetRegFileFilterListIndex();
    std::vector<FilterEntry> entries = FilterEntries();
    const auto chosen = std::find_if(entries.begin(), entries.end(),
                                     [&choice](const FilterEntry& entry) { return IsChosen(entry, choice); });
    if (chosen != entries.end())
        std::rotate(entries.begin(), chosen, std::next(chosen));
    filter = CStdStr();
    for (const FilterEntry& entry : entries)
        filter += entry.description + CStdStr(L"|") + entry.patterns + CStdStr(L"|");
}
} // namespace ModrigUtils
