#include "host/applications/ShippedRecords.h"

#include <optional>

#include "host/registry/RegistryLayers.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
using Languages = std::vector<std::string>;

std::wstring textAt(const RegistryTree& tree, const std::wstring& key, const std::wstring& name)
{
    const auto* value = tree.value(key, name);
    return value ? value->data : L"";
}

// The value of that name in the first of the languages that has it, or else beside them.
std::wstring spokenText(const RegistryTree& tree, const std::wstring& key, const std::wstring& name,
                        const Languages& languages)
{
    const std::wstring below = key + L"\\";
    for (const std::string& language : languages)
        if (const auto* value = tree.value(below + toWide(language), name))
            return value->data;
    return textAt(tree, key, name);
}

std::optional<ShippedRecord> readRecord(const RegistryTree& tree, const std::wstring& key,
                                        const std::wstring& name, const std::filesystem::path& folder,
                                        const Languages& languages)
{
    const std::wstring module = textAt(tree, key, L"Module");
    const auto reasons = parseLoadReasons(textAt(tree, key, L"LoadReasons"));
    if (module.empty() || !reasons)
        return std::nullopt;
    ShippedRecord shipped;
    shipped.record.name = name;
    shipped.record.module = toWide((folder / toUtf8(module)).native());
    shipped.record.description = textAt(tree, key, L"Description");
    shipped.record.loadReasons = *reasons;
    for (const auto& command : tree.values(key + L"\\Commands"))
    {
        shipped.record.commands.emplace_back(command.name, command.data);
        shipped.commands.push_back({textAt(tree, key, L"Group"), command.data,
                                    spokenText(tree, key + L"\\Usage", command.name, languages),
                                    spokenText(tree, key + L"\\Summaries", command.name, languages)});
    }
    return shipped;
}
} // namespace

std::vector<ShippedRecord> readShippedRecords(const std::filesystem::path& folder,
                                              const std::wstring& productRoot, const Languages& languages)
{
    const RegistryTree tree = readRegistryLayers({folder}).defaults;
    const std::wstring above = productRoot + L"\\Applications\\";
    std::vector<ShippedRecord> records;
    for (const std::wstring& name : tree.subKeys(above))
        if (auto record = readRecord(tree, above + name, name, folder, languages))
            records.push_back(*std::move(record));
    return records;
}
} // namespace tessel
