#include "host/resources/ResourceModules.h"

#include <algorithm>
#include <filesystem>
#include <utility>

#include "host/commands/CallingApplication.h"
#include "host/platform/Bundle.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr wchar_t kBetweenFolders = L'/';
constexpr std::uint64_t kLargestModule = std::uint64_t{64} << 20;
// Handles rise from here; smaller values could be taken for the ids of texts.
constexpr std::uintptr_t kHandlesBegin = 0x10000;

std::wstring withOneKindOfSeparator(const wchar_t* name)
{
    std::wstring result = name ? name : L"";
    std::ranges::replace(result, L'\\', kBetweenFolders);
    return result;
}

// Where the application's resources are; empty outside of a call.
std::wstring resourcesOf(const std::wstring& application)
{
    if (!isBundlePath(toUtf8(application)))
        return application.substr(0, application.rfind(kBetweenFolders) + 1);
    for (const wchar_t* folder : {L"/Resources", L"/Contents/Resources"})
    {
        std::error_code failed; // what cannot be reached holds nothing that we could open
        if (std::filesystem::is_directory(toUtf8(application + folder), failed))
            return application + folder;
    }
    return application;
}

// Of two places at most.
std::wstring noneOf(const std::vector<std::wstring>& places)
{
    return places.size() > 1
               ? translated(L"there is no \"{}\" and no \"{}\"", places.front(), places.back())
               : translated(L"there is no \"{}\"", places.empty() ? std::wstring() : places.front());
}

Failure notOpened(const std::wstring& name, const std::wstring& reason)
{
    return {translated(L"The resource module \"{}\" cannot be opened: {}.", name, reason)};
}
} // namespace

ResourceModules::ResourceModules(std::wstring hostFolder, const CallingApplication& calls,
                                 const std::vector<std::string>& languages)
    : mHostFolder(std::move(hostFolder)), mCalls(calls), mWantedLanguages(numbersOf(languages)),
      mLastHandle(kHandlesBegin)
{
}

std::vector<std::wstring> ResourceModules::placesOf(const std::wstring& name) const
{
    if (name.starts_with(kBetweenFolders))
        return {name};
    std::vector<std::wstring> places;
    for (std::wstring place : {resourcesOf(mCalls.path()), mHostFolder})
    {
        if (place.empty())
            continue;
        if (!place.ends_with(kBetweenFolders))
            place += kBetweenFolders;
        places.push_back(place += name);
    }
    return places;
}

Result<HMODULE> ResourceModules::open(const wchar_t* name)
{
    const std::wstring plainName = withOneKindOfSeparator(name);
    if (plainName.empty())
        return notOpened(plainName, translated(L"it has no name"));
    const auto places = placesOf(plainName);
    for (const std::wstring& place : places)
    {
        const RegularFile file(toUtf8(place));
        if (file.opened().code() == kNothingThere)
            continue;
        const auto module = openFile(file);
        return module ? module : notOpened(place, module.sentence());
    }
    return notOpened(plainName, noneOf(places));
}

// What this says of a failure is the end of a sentence.
Result<HMODULE> ResourceModules::openFile(const RegularFile& file)
{
    const auto known = std::ranges::find_if(mEntries, [&](const auto& entry)
                                            { return entry.second.identity == file.identity(); });
    if (file.opened() && known != mEntries.end())
    {
        ++known->second.references;
        return known->first;
    }
    if (file.size() > kLargestModule)
        return Failure{translated(L"the file is too large for a resource module")};
    if (!file.opened())
        return file.opened().failure();
    std::vector<std::uint8_t> bytes(file.size());
    if (!file.read(0, bytes.data(), bytes.size()))
        return Failure{translated(L"the file cannot be read")};
    auto resources = PeResources::read(std::move(bytes));
    if (!resources)
        return resources.failure();
    const auto handle = reinterpret_cast<HMODULE>(++mLastHandle);
    auto languages = inWantedOrder(resources->languages(), mWantedLanguages);
    mEntries.emplace(handle, Entry{file.identity(), *std::move(resources), std::move(languages), 1});
    return handle;
}

bool ResourceModules::close(HMODULE module)
{
    const auto entry = mEntries.find(module);
    if (entry == mEntries.end())
        return false;
    if (--entry->second.references == 0)
        mEntries.erase(entry);
    return true;
}

std::wstring ResourceModules::string(HMODULE module, unsigned id) const
{
    const auto entry = mEntries.find(module ? module : mCurrent);
    if (entry == mEntries.end())
        return {};
    for (const LanguageNumber language : entry->second.languages)
        if (std::wstring text = entry->second.resources.string(id, language); !text.empty())
            return text;
    return {};
}
} // namespace tessel
