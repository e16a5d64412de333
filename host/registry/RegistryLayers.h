// What an administrator lays out for everybody, in registry files that are only read. Values that a person's
// own registry does not have come from the defaults; those of the policy stand before the person's own.
//
// Of several folders the later ones stand before the earlier; in a folder the files count in the order of
// their names. `*.reg` in it are defaults, `policy/*.reg` are policy.
#pragma once

#include <cstdint>
#include <filesystem>
#include <map>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "host/registry/RegistryText.h"

namespace tessel
{
// Keys and values from such files. Names compare without regard to case and keep the spelling that they came
// with first; the order is that of the files.
class RegistryTree
{
public:
    struct Value
    {
        std::wstring name;
        std::wstring data;
        std::filesystem::path file; // that it comes from
    };

    void apply(const std::vector<RegistryChange>& changes, const std::filesystem::path& file);

    bool isEmpty() const { return mRoot.below.empty() && mRoot.values.empty(); }
    // Paths are below the root, their parts separated by one backslash.
    bool hasKey(std::wstring_view path) const { return find(path) != nullptr; }
    std::vector<std::wstring> subKeys(std::wstring_view path) const;
    const std::vector<Value>& values(std::wstring_view path) const;
    // Null when there is none.
    const Value* value(std::wstring_view path, std::wstring_view name) const;

private:
    struct Node
    {
        std::wstring name;
        std::vector<Value> values;
        std::map<std::wstring, std::size_t> indexOfValue; // by folded names
        std::vector<std::unique_ptr<Node>> below;
        std::map<std::wstring, Node*> keys; // by folded names
    };

    const Node* find(std::wstring_view path) const;
    Node& make(std::wstring_view path);
    void removeKey(std::wstring_view path);
    static void set(Node& node, Value value);
    static void removeValue(Node& node, const std::wstring& name);

    Node mRoot;
};

struct RegistryLayers
{
    RegistryTree defaults;
    RegistryTree policy;
    std::vector<std::wstring> sentences; // about what could not be read or understood, and does not count
    std::uint32_t mark = 0;              // of the files that count: others have another one, none have 0

    bool isEmpty() const { return defaults.isEmpty() && policy.isEmpty(); }
};

// Folders that are not there count for nothing, and nothing is said of them.
RegistryLayers readRegistryLayers(const std::vector<std::filesystem::path>& folders);

// The parts of a key path, empty ones passed over.
std::vector<std::wstring> partsOfKeyPath(std::wstring_view path);
} // namespace tessel
