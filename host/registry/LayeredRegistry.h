// The registry as everybody sees it: a person's own one, with what an administrator has laid out under it and
// before it. Where nothing is laid out it is the person's own, call by call.
//
// Only the person's own registry is ever written. What is written where the policy stands before it is kept,
// does not count, and is told. To go through the values by index, as who replaces them all does, is to go
// through the person's own: the others cannot be removed.
#pragma once

#include <cstdint>
#include <filesystem>
#include <functional>
#include <map>
#include <optional>
#include <set>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "host/registry/Registry.h"
#include "host/registry/RegistryLayers.h"

namespace tessel
{
class LayeredRegistry
{
public:
    using Key = Registry::Key;
    using Say = std::function<void(const std::wstring& sentence)>;

    struct Value
    {
        std::wstring name;
        std::wstring data;
        std::filesystem::path file; // that lays it out; empty for the person's own
    };

    // The registry is the caller's, and is to outlive this.
    LayeredRegistry(Registry& own, RegistryLayers layers, Say say);
    explicit LayeredRegistry(Registry& own) : LayeredRegistry(own, {}, {}) {}
    LayeredRegistry(const LayeredRegistry&) = delete;
    LayeredRegistry& operator=(const LayeredRegistry&) = delete;

    Registry& own() const { return mOwn; }

    // About what is laid out and does not count.
    const std::vector<std::wstring>& sentences() const { return mLayers.sentences; }

    // Tells what is laid out today from what was laid out another day.
    std::uint32_t markOfLayers() const { return mLayers.mark; }

    // All as in Registry.
    Key find(std::wstring_view path, Key from = Registry::kRoot);
    Result<Key> create(std::wstring_view path, Key from);
    std::vector<std::wstring> subKeys(Key key);
    Result<> removeKey(Key key);
    Result<std::wstring> readValue(Key key, std::wstring_view name);
    Result<> writeValue(Key key, std::wstring_view name, std::wstring_view data);
    Result<> removeValue(Key key, std::wstring_view name);
    Result<std::wstring> valueName(Key key, DWORD index);
    std::optional<std::wstring> read(std::wstring_view path, std::wstring_view name);
    Result<> write(std::wstring_view path, std::wstring_view name, std::wstring_view data);

    // The file in which the administrator has laid the value down, if one has: it stands before the person's.
    std::optional<std::filesystem::path> laidDownIn(Key key, std::wstring_view name) const;

    // Whether what counts under that name may be something else than what is found: the person's own registry
    // could not be read there, or is damaged. What is laid down counts in any case.
    bool mayHaveMissed(std::wstring_view path, std::wstring_view name);

    // Who replaces all values of a key calls it before the first change, and `endOfCommand` in place of the
    // own registry's: where what is the person's own is what counted before, it becomes again what it was
    // then. A list that was stored as it had been read is no wish of the person's.
    void expectReplacement(Key key);
    Result<> endOfCommand();

    // In place of the own registry's, for what was replaced by then.
    Result<> store();

    HKEY openHandle(Key key);
    std::optional<Key> keyOf(HKEY handle) const;
    bool closeHandle(HKEY handle);

    // What counts: the person's own values first, then what is laid out beside them.
    std::vector<Value> values(Key key);

private:
    bool isPlain() const { return mLayers.isEmpty(); }
    // The path of a key, and the key for a path, of this session.
    const std::wstring& pathOf(Key key) const { return mPaths[static_cast<std::size_t>(key - 1)]; }
    std::wstring pathBelow(std::wstring_view path, Key from) const;
    Key keyFor(const std::wstring& path);
    bool isThere(const std::wstring& path);
    Key ownKey(Key key);
    struct Before
    {
        Key key;
        std::vector<Registry::Value> own;
        std::vector<Value> counting;
    };
    void putBackWhatDidNotChange();
    void putBackIfNothingChanged(const Before& before);
    void tellLaidDown(const std::wstring& path, const RegistryTree::Value& value);

    Registry& mOwn;
    const RegistryLayers mLayers;
    const Say mSay;
    std::vector<std::wstring> mPaths;  // by key, from 1
    std::map<std::wstring, Key> mKeys; // by folded paths
    std::set<std::wstring> mTold;      // folded paths of keys
    std::map<Key, Before> mBefore;     // of keys with values that are laid out
    std::unordered_map<HKEY, Key> mHandles;
    std::uintptr_t mNextHandle;
};
} // namespace tessel
