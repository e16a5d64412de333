#include "host/applications/LoadedModules.h"

#include <algorithm>
#include <utility>

#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
Module* find(const auto& index, const auto& key)
{
    const auto found = index.find(key);
    return found == index.end() ? nullptr : &*found->second;
}
} // namespace

Module& LoadedModules::add(std::unique_ptr<Module> module)
{
    Module& added = *module;
    mByHandle[&added] = std::move(module);
    mByPath[added.path] = &added;
    if (!added.otherPath.empty())
        mByPath[added.otherPath] = &added;
    mByIdentity[added.identity] = &added;
    return added;
}

void LoadedModules::countAsLoaded(Module& module)
{
    if (module.isLoaded)
        return;
    module.isLoaded = true;
    mLoaded.push_back(&module);
    mNames.push_back(module.name());
    mByName[foldCase(module.name())].push_back(&module);
}

void LoadedModules::remove(Module& module)
{
    if (module.isLoaded)
    {
        const auto named = mByName.find(foldCase(module.name()));
        std::erase(named->second, &module);
        if (named->second.empty())
            mByName.erase(named);
        // The session's end takes the last away each time, and a person's selection goes from the first on.
        const auto place =
            mLoaded.back() == &module ? mLoaded.end() - 1 : std::ranges::find(mLoaded, &module);
        mNames.erase(mNames.begin() + (place - mLoaded.begin()));
        mLoaded.erase(place);
    }
    mByPath.erase(module.path);
    if (!module.otherPath.empty())
        mByPath.erase(module.otherPath);
    mByIdentity.erase(module.identity);
    mByHandle.erase(&module);
}

Module* LoadedModules::withPath(std::wstring_view path) const
{
    return find(mByPath, path);
}

Module* LoadedModules::withIdentity(const FileIdentity& identity) const
{
    return find(mByIdentity, identity);
}

Module* LoadedModules::withHandle(const void* handle) const
{
    return find(mByHandle, handle);
}

const Module* LoadedModules::named(std::wstring_view name) const
{
    const auto found = mByName.find(foldCase(name));
    return found == mByName.end() ? nullptr : found->second.front();
}
} // namespace tessel
