#include "host/registry/LayeredRegistry.h"

#include <algorithm>
#include <utility>

#include "host/text/Translation.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
// Unlike every handle that the person's own registry gives.
constexpr std::uintptr_t kFirstLayeredHandle = 0x40000001;

std::map<std::wstring, std::wstring> byFoldedNames(const auto& values)
{
    std::map<std::wstring, std::wstring> result;
    for (const auto& value : values)
        result.emplace(foldCase(value.name), value.data);
    return result;
}

bool areAlike(const auto& some, const auto& others)
{
    return byFoldedNames(some) == byFoldedNames(others);
}
} // namespace

LayeredRegistry::LayeredRegistry(Registry& own, RegistryLayers layers, Say say)
    : mOwn(own), mLayers(std::move(layers)), mSay(std::move(say)), mPaths{L""}, mKeys{{L"", Registry::kRoot}},
      mNextHandle(kFirstLayeredHandle)
{
}

std::wstring LayeredRegistry::pathBelow(std::wstring_view path, Key from) const
{
    std::wstring whole = pathOf(from);
    for (const std::wstring& part : partsOfKeyPath(path))
        whole += (whole.empty() ? L"" : L"\\") + part;
    return whole;
}

LayeredRegistry::Key LayeredRegistry::keyFor(const std::wstring& path)
{
    const auto [known, isNew] = mKeys.emplace(foldCase(path), static_cast<Key>(mPaths.size() + 1));
    if (isNew)
        mPaths.push_back(path);
    return known->second;
}

bool LayeredRegistry::isThere(const std::wstring& path)
{
    return mLayers.policy.hasKey(path) || mOwn.find(path) != Registry::kNoKey ||
           mLayers.defaults.hasKey(path);
}

LayeredRegistry::Key LayeredRegistry::ownKey(Key key)
{
    return mOwn.find(pathOf(key));
}

LayeredRegistry::Key LayeredRegistry::find(std::wstring_view path, Key from)
{
    if (isPlain())
        return mOwn.find(path, from);
    const std::wstring whole = pathBelow(path, from);
    return isThere(whole) ? keyFor(whole) : Registry::kNoKey;
}

Result<LayeredRegistry::Key> LayeredRegistry::create(std::wstring_view path, Key from)
{
    if (isPlain())
        return mOwn.create(path, from);
    const std::wstring whole = pathBelow(path, from);
    const auto made = mOwn.create(whole, Registry::kRoot);
    return made ? Result<Key>(keyFor(whole)) : made.failure();
}

std::vector<std::wstring> LayeredRegistry::subKeys(Key key)
{
    if (isPlain())
        return mOwn.subKeys(key);
    const Key own = ownKey(key);
    auto names = own == Registry::kNoKey ? std::vector<std::wstring>() : mOwn.subKeys(own);
    std::set<std::wstring> known;
    for (const std::wstring& name : names)
        known.insert(foldCase(name));
    for (const RegistryTree* tree : {&mLayers.policy, &mLayers.defaults})
        for (const std::wstring& name : tree->subKeys(pathOf(key)))
            if (known.insert(foldCase(name)).second)
                names.push_back(name);
    return names;
}

Result<> LayeredRegistry::removeKey(Key key)
{
    if (isPlain())
        return mOwn.removeKey(key);
    const Key own = ownKey(key);
    return own == Registry::kNoKey ? Result<>() : mOwn.removeKey(own);
}

Result<std::wstring> LayeredRegistry::readValue(Key key, std::wstring_view name)
{
    if (isPlain())
        return mOwn.readValue(key, name);
    const std::wstring& path = pathOf(key);
    if (const auto* laidDown = mLayers.policy.value(path, name))
        return laidDown->data;
    const Key own = ownKey(key);
    auto found = own == Registry::kNoKey ? Failure{{}, ERROR_FILE_NOT_FOUND} : mOwn.readValue(own, name);
    const auto* byDefault =
        found.code() == ERROR_FILE_NOT_FOUND ? mLayers.defaults.value(path, name) : nullptr;
    return byDefault ? byDefault->data : found;
}

void LayeredRegistry::tellLaidDown(const std::wstring& path, const RegistryTree::Value& value)
{
    if (mSay && mTold.insert(foldCase(path)).second)
        mSay(translated(L"Values of \"{}\" are laid down by the administrator, in {}: what is changed in "
                        L"them does not count.",
                        path, value.file));
}

Result<> LayeredRegistry::writeValue(Key key, std::wstring_view name, std::wstring_view data)
{
    if (isPlain())
        return mOwn.writeValue(key, name, data);
    const std::wstring path = pathOf(key);
    const auto own = mOwn.create(path, Registry::kRoot);
    if (!own)
        return own.failure();
    if (const auto* laidDown = mLayers.policy.value(path, name); laidDown && laidDown->data != data)
        tellLaidDown(path, *laidDown);
    return mOwn.writeValue(*own, name, data);
}

Result<> LayeredRegistry::removeValue(Key key, std::wstring_view name)
{
    if (isPlain())
        return mOwn.removeValue(key, name);
    const Key own = ownKey(key);
    return own == Registry::kNoKey ? Failure{{}, ERROR_FILE_NOT_FOUND} : mOwn.removeValue(own, name);
}

Result<std::wstring> LayeredRegistry::valueName(Key key, DWORD index)
{
    if (isPlain())
        return mOwn.valueName(key, index);
    const Key own = ownKey(key);
    return own == Registry::kNoKey ? Failure{{}, ERROR_NO_MORE_ITEMS} : mOwn.valueName(own, index);
}

std::optional<std::wstring> LayeredRegistry::read(std::wstring_view path, std::wstring_view name)
{
    if (isPlain())
        return mOwn.read(path, name);
    const Key key = find(path);
    auto data = key == Registry::kNoKey ? Failure{} : readValue(key, name);
    return data ? std::optional(*std::move(data)) : std::nullopt;
}

Result<> LayeredRegistry::write(std::wstring_view path, std::wstring_view name, std::wstring_view data)
{
    if (isPlain())
        return mOwn.write(path, name, data);
    const auto key = create(path, Registry::kRoot);
    return key ? writeValue(*key, name, data) : key.failure();
}

std::vector<LayeredRegistry::Value> LayeredRegistry::values(Key key)
{
    std::vector<Value> counting;
    const Key own = isPlain() ? key : ownKey(key);
    if (own != Registry::kNoKey)
        for (auto& value : mOwn.values(own))
            counting.push_back({std::move(value.name), std::move(value.data), {}});
    if (isPlain())
        return counting;
    for (const auto& laidDown : mLayers.policy.values(pathOf(key)))
    {
        std::erase_if(counting,
                      [&](const Value& value) { return equalIgnoringCase(value.name, laidDown.name); });
        counting.push_back({laidDown.name, laidDown.data, laidDown.file});
    }
    for (const auto& byDefault : mLayers.defaults.values(pathOf(key)))
        if (std::ranges::none_of(counting, [&](const Value& value)
                                 { return equalIgnoringCase(value.name, byDefault.name); }))
            counting.push_back({byDefault.name, byDefault.data, byDefault.file});
    return counting;
}

std::optional<std::filesystem::path> LayeredRegistry::laidDownIn(Key key, std::wstring_view name) const
{
    const auto* laidDown = isPlain() ? nullptr : mLayers.policy.value(pathOf(key), name);
    return laidDown ? std::optional(laidDown->file) : std::nullopt;
}

bool LayeredRegistry::mayHaveMissed(std::wstring_view path, std::wstring_view name)
{
    if (mLayers.policy.value(path, name))
        return false;
    const Key own = mOwn.find(path);
    const bool isFound = own != Registry::kNoKey && mOwn.readValue(own, name);
    return !isFound && mOwn.mayHaveMissed();
}

void LayeredRegistry::expectReplacement(Key key)
{
    if (isPlain() || mBefore.contains(key))
        return;
    const std::wstring& path = pathOf(key);
    if (mLayers.policy.values(path).empty() && mLayers.defaults.values(path).empty())
        return;
    const Key own = ownKey(key);
    mBefore.emplace(key,
                    Before{key, own == Registry::kNoKey ? std::vector<Registry::Value>() : mOwn.values(own),
                           values(key)});
}

Result<> LayeredRegistry::endOfCommand()
{
    putBackWhatDidNotChange();
    return mOwn.endOfCommand();
}

Result<> LayeredRegistry::store()
{
    putBackWhatDidNotChange();
    return mOwn.store();
}

void LayeredRegistry::putBackWhatDidNotChange()
{
    for (const auto& [key, before] : std::exchange(mBefore, {}))
        putBackIfNothingChanged(before);
}

// What fails here fails in all of the command, which is then undone and told.
void LayeredRegistry::putBackIfNothingChanged(const Before& before)
{
    const Key own = ownKey(before.key);
    const auto now = own == Registry::kNoKey ? std::vector<Registry::Value>() : mOwn.values(own);
    if (!areAlike(now, before.counting) || areAlike(now, before.own))
        return;
    for (const auto& value : now)
        static_cast<void>(mOwn.removeValue(own, value.name));
    for (const auto& value : before.own)
        static_cast<void>(mOwn.writeValue(own, value.name, value.data));
}

HKEY LayeredRegistry::openHandle(Key key)
{
    if (isPlain())
        return mOwn.openHandle(key);
    const HKEY handle = reinterpret_cast<HKEY>(mNextHandle++);
    mHandles.emplace(handle, key);
    return handle;
}

std::optional<LayeredRegistry::Key> LayeredRegistry::keyOf(HKEY handle) const
{
    if (isPlain() || handle == HKEY_CURRENT_USER)
        return mOwn.keyOf(handle);
    const auto found = mHandles.find(handle);
    return found == mHandles.end() ? std::nullopt : std::optional(found->second);
}

bool LayeredRegistry::closeHandle(HKEY handle)
{
    if (isPlain() || handle == HKEY_CURRENT_USER)
        return mOwn.closeHandle(handle);
    return mHandles.erase(handle) > 0;
}
} // namespace tessel
