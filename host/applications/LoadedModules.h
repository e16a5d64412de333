// The compiled applications that the host knows: those that count as loaded, and those whose load message
// still runs.
#pragma once

#include <cstddef>
#include <map>
#include <memory>
#include <span>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include <tessel/tsrx.h>

#include "host/applications/ModuleLibrary.h"
#include "host/platform/RegularFile.h"

namespace tessel
{
// One application. Its address is the handle that its entry point receives.
struct Module
{
    std::wstring path;      // full, as it was first asked for
    std::wstring otherPath; // where that led through all links; empty when it led nowhere else
    FileIdentity identity;
    std::unique_ptr<ModuleLibrary> library;
    TsRxEntryPoint entryPoint = nullptr;
    bool isLoaded = false;
    bool locked = false;

    // The file name with its extension: the end of the path.
    std::wstring_view name() const { return std::wstring_view(path).substr(path.rfind(L'/') + 1); }
};

class LoadedModules
{
public:
    // Takes the application in, not loaded yet.
    Module& add(std::unique_ptr<Module> module);
    // It counts as loaded from now on. A second call does nothing.
    void countAsLoaded(Module& module);
    // Forgets it; the reference ends here.
    void remove(Module& module);

    // Each answers null when there is none. A path is the one asked for or the real one.
    Module* withPath(std::wstring_view path) const;
    Module* withIdentity(const FileIdentity& identity) const;
    Module* withHandle(const void* handle) const;
    // The first of those loaded that share a name, in any case of letters.
    const Module* named(std::wstring_view name) const;

    // In the order in which they came to count as loaded.
    const std::vector<Module*>& loaded() const { return mLoaded; }
    // Their names, in the same order.
    std::span<const std::wstring_view> namesOfLoaded() const { return mNames; }

private:
    std::unordered_map<const void*, std::unique_ptr<Module>> mByHandle;
    std::unordered_map<std::wstring_view, Module*> mByPath; // the texts are the modules' own
    std::map<FileIdentity, Module*> mByIdentity;
    std::unordered_map<std::wstring, std::vector<Module*>> mByName; // folded; in the order of loading
    std::vector<Module*> mLoaded;
    std::vector<std::wstring_view> mNames; // the modules' own, kept at hand: they are asked for all at once
};
} // namespace tessel
