#include "host/registry/RegistryLayers.h"

#include <algorithm>
#include <cstdint>
#include <system_error>
#include <utility>

#include <libdeflate.h>

#include "host/platform/OrdinaryFile.h"
#include "host/platform/SystemFailure.h"
#include "host/registry/KeyPath.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace fs = std::filesystem;

namespace
{
constexpr std::uintmax_t kMostLayerBytes = std::uintmax_t{64} << 20;
constexpr wchar_t kKeySeparator = L'\\';

std::wstring doesNotCount(const fs::path& place, const std::wstring& reason)
{
    return translated(L"The values for everybody in {} do not count: {}.", place, reason);
}

// None where there is no such folder. Fails with the system's words.
Result<std::vector<fs::path>> registryFilesIn(const fs::path& folder)
{
    std::vector<fs::path> files;
    std::error_code failed;
    for (auto entry = fs::directory_iterator(folder, failed); !failed && entry != fs::directory_iterator();
         entry.increment(failed))
        if (equalIgnoringCase(toWide(entry->path().extension().native()), L".reg"))
            files.push_back(entry->path());
    if (failed && failed != std::errc::no_such_file_or_directory)
        return systemFailure(failed.value());
    std::ranges::sort(files);
    return files;
}

std::uint32_t markAfter(std::uint32_t mark, std::string_view bytes)
{
    return libdeflate_crc32(mark, bytes.data(), bytes.size());
}

void take(const fs::path& file, RegistryTree& tree, RegistryLayers& layers)
{
    const auto bytes = readOrdinaryFile(file, kMostLayerBytes);
    const auto changes = bytes ? readRegistryText(*bytes) : bytes.failure();
    if (!changes)
    {
        layers.sentences.push_back(doesNotCount(file, changes.sentence()));
        return;
    }
    tree.apply(*changes, file);
    layers.mark = markAfter(markAfter(layers.mark, &tree == &layers.policy ? "policy" : "default"), *bytes);
}

// False where the folder cannot be read: nothing in it counts then, not a part of it.
bool takeAll(const fs::path& folder, RegistryTree& tree, RegistryLayers& layers)
{
    const auto files = registryFilesIn(folder);
    if (!files)
        layers.sentences.push_back(doesNotCount(folder, files.sentence()));
    else
        for (const fs::path& file : *files)
            take(file, tree, layers);
    return static_cast<bool>(files);
}
} // namespace

std::vector<std::wstring> partsOfKeyPath(std::wstring_view path)
{
    std::vector<std::wstring> parts;
    while (!path.empty())
        if (const auto part = takeKeyPart(path); !part.empty())
            parts.emplace_back(part);
    return parts;
}

const RegistryTree::Node* RegistryTree::find(std::wstring_view path) const
{
    const Node* node = &mRoot;
    for (const std::wstring& part : partsOfKeyPath(path))
    {
        const auto found = node->keys.find(foldCase(part));
        if (found == node->keys.end())
            return nullptr;
        node = found->second;
    }
    return node;
}

RegistryTree::Node& RegistryTree::make(std::wstring_view path)
{
    Node* node = &mRoot;
    for (std::wstring& part : partsOfKeyPath(path))
    {
        Node*& below = node->keys[foldCase(part)];
        if (!below)
        {
            below = node->below.emplace_back(std::make_unique<Node>()).get();
            below->name = std::move(part);
        }
        node = below;
    }
    return *node;
}

void RegistryTree::removeKey(std::wstring_view path)
{
    auto parts = partsOfKeyPath(path);
    if (parts.empty() || !find(path))
        return;
    const std::wstring fold = foldCase(parts.back());
    parts.pop_back();
    std::wstring above;
    for (const std::wstring& part : parts)
        above += part + kKeySeparator;
    Node& node = make(above);
    const Node* gone = node.keys.at(fold);
    node.keys.erase(fold);
    std::erase_if(node.below, [&](const auto& key) { return key.get() == gone; });
}

void RegistryTree::set(Node& node, Value value)
{
    const auto [place, isNew] = node.indexOfValue.emplace(foldCase(value.name), node.values.size());
    if (isNew)
        node.values.push_back(std::move(value));
    else
    {
        value.name = node.values[place->second].name;
        node.values[place->second] = std::move(value);
    }
}

void RegistryTree::removeValue(Node& node, const std::wstring& name)
{
    const auto found = node.indexOfValue.find(foldCase(name));
    if (found == node.indexOfValue.end())
        return;
    auto kept = std::exchange(node.values, {});
    kept.erase(kept.begin() + static_cast<std::ptrdiff_t>(found->second));
    node.indexOfValue.clear();
    for (Value& value : kept)
        set(node, std::move(value));
}

void RegistryTree::apply(const std::vector<RegistryChange>& changes, const fs::path& file)
{
    using Kind = RegistryChange::Kind;
    for (const RegistryChange& change : changes)
        if (change.kind == Kind::kRemoveKey)
            removeKey(change.key);
        else if (change.kind == Kind::kSetValue)
            set(make(change.key), {change.name, change.data, file});
        else if (change.kind == Kind::kRemoveValue)
            removeValue(make(change.key), change.name);
        else
            make(change.key);
}

std::vector<std::wstring> RegistryTree::subKeys(std::wstring_view path) const
{
    std::vector<std::wstring> names;
    if (const Node* node = find(path))
        for (const auto& key : node->below)
            names.push_back(key->name);
    return names;
}

const std::vector<RegistryTree::Value>& RegistryTree::values(std::wstring_view path) const
{
    static const std::vector<Value> none;
    const Node* node = find(path);
    return node ? node->values : none;
}

const RegistryTree::Value* RegistryTree::value(std::wstring_view path, std::wstring_view name) const
{
    const Node* node = find(path);
    if (!node)
        return nullptr;
    const auto found = node->indexOfValue.find(foldCase(name));
    return found == node->indexOfValue.end() ? nullptr : &node->values[found->second];
}

RegistryLayers readRegistryLayers(const std::vector<fs::path>& folders)
{
    RegistryLayers layers;
    for (const fs::path& folder : folders)
        if (takeAll(folder, layers.defaults, layers)) // otherwise all in it has been told of
            takeAll(folder / "policy", layers.policy, layers);
    return layers;
}
} // namespace tessel
