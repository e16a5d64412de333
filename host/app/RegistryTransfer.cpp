#include "host/app/RegistryTransfer.h"

#include <algorithm>
#include <cstdint>
#include <vector>

#include "host/platform/OrdinaryFile.h"
#include "host/platform/PartFile.h"
#include "host/registry/Registry.h"
#include "host/text/Translation.h"

namespace tessel
{
namespace
{
constexpr std::uintmax_t kMostBytes = std::uintmax_t{256} << 20;

using Change = RegistryChange;

Failure notExported(const std::wstring& key, const std::filesystem::path& file, const std::wstring& reason)
{
    return {translated(L"The registry key \"{}\" is not exported to {}: {}.", key, file, reason)};
}

Failure notImported(const std::filesystem::path& file, const std::wstring& reason)
{
    return {translated(L"The file {} is not imported: {}.", file, reason)};
}

// What the store says of a command that failed in it, for the end of a sentence.
std::wstring wordsOf(const Registry& registry, const Result<>& command)
{
    std::wstring words = command ? registry.canStore().sentence() : command.sentence();
    words.resize(std::min(words.size(), words.find_last_not_of(L'.') + 1));
    return words;
}

// Each key is followed by its values, and these by the keys below it: the order in which it can be made
// again.
std::vector<Change> changesThatMake(Registry& registry, const std::wstring& top)
{
    std::vector<Change> changes;
    std::vector<std::wstring> left = {top};
    while (!left.empty())
    {
        const std::wstring path = std::move(left.back());
        left.pop_back();
        const auto key = registry.find(path);
        changes.push_back({Change::Kind::kMakeKey, path, L"", L""});
        for (auto& value : registry.values(key))
            changes.push_back({Change::Kind::kSetValue, path, std::move(value.name), std::move(value.data)});
        auto below = registry.subKeys(key);
        for (auto name = below.rbegin(); name != below.rend(); ++name)
            left.push_back(path.empty() ? *name : path + L"\\" + *name);
    }
    return changes;
}

// Somebody may have typed the name of another file of theirs.
Result<> checkMayReplace(const std::filesystem::path& file)
{
    const auto there = readOrdinaryFile(file, kMostBytes);
    if (!there)
        return there.code() == kNothingThere ? Result<>() : there.failure();
    return readRegistryText(*there)
               ? Result<>()
               : Failure{translated(L"another file stands there, which is no registry file")};
}

std::wstring countedKeys(const std::vector<Change>& changes)
{
    const auto keys = std::ranges::count(changes, Change::Kind::kMakeKey, &Change::kind);
    return translatedByCount(static_cast<std::size_t>(keys), L"{} key", L"{} keys");
}

// After "with".
std::wstring countedValues(const std::vector<Change>& changes)
{
    const auto values = std::ranges::count(changes, Change::Kind::kSetValue, &Change::kind);
    return translatedByCount(static_cast<std::size_t>(values), L"{} value", L"{} values");
}

// What is to go and is not there has gone.
Result<> apply(Registry& registry, const Change& change, Registry::Key& key)
{
    if (change.kind == Change::Kind::kMakeKey)
    {
        const auto made = registry.create(change.key, Registry::kRoot);
        key = made ? *made : Registry::kNoKey;
        return made ? Result<>() : made.failure();
    }
    if (change.kind == Change::Kind::kSetValue)
        return registry.writeValue(key, change.name, change.data);
    const bool isKey = change.kind == Change::Kind::kRemoveKey;
    const auto goes = isKey ? registry.find(change.key) : key;
    if (goes == Registry::kNoKey)
        return {};
    auto removed = isKey ? registry.removeKey(goes) : registry.removeValue(goes, change.name);
    return removed.code() == ERROR_FILE_NOT_FOUND ? Result<>() : removed;
}
} // namespace

Result<std::wstring> exportRegistry(Registry& registry, const std::wstring& key,
                                    const std::filesystem::path& file, RegistryTextForm form)
{
    if (registry.find(key) == Registry::kNoKey)
        return notExported(key, file,
                           registry.mayHaveMissed() ? wordsOf(registry, registry.endOfCommand())
                                                    : translated(L"there is no such key"));
    const auto changes = changesThatMake(registry, key);
    if (registry.readFailed())
        return notExported(key, file, wordsOf(registry, registry.endOfCommand()));
    const auto text = writeRegistryText(changes, form);
    if (!text)
        return notExported(key, file, text.sentence());
    if (const auto may = checkMayReplace(file); !may)
        return notExported(key, file, may.sentence());
    if (const auto written = replacePersonsFile(file, *text); !written)
        return notExported(key, file, written.sentence());
    return translated(L"Exported to {}: {} with {}.", file, countedKeys(changes), countedValues(changes));
}

Result<std::wstring> importRegistry(Registry& registry, const std::filesystem::path& file)
{
    const auto bytes = readOrdinaryFile(file, kMostBytes);
    if (!bytes)
        return notImported(file, bytes.sentence());
    const auto changes = readRegistryText(*bytes);
    if (!changes)
        return notImported(file, changes.sentence());
    Registry::Key key = Registry::kNoKey;
    for (const Change& change : *changes)
        if (!apply(registry, change, key))
            return notImported(file, wordsOf(registry, registry.endOfCommand()));
    if (const auto stored = registry.endOfCommand(); !stored)
        return notImported(file, wordsOf(registry, stored));
    return translated(L"Imported from {}: {} with {}.", file, countedKeys(*changes), countedValues(*changes));
}
} // namespace tessel
