#include "bench/Loaders.h"

#include <dlfcn.h>
#include <gmodule.h>
#include <ltdl.h>
#include <tessel/tsrxlinker.h>

#include <QLibrary>
#include <algorithm>
#include <cstddef>

#include "bench/Child.h"
#include "bench/Session.h"
#include "modrig/loader/ApplicationLoader.h"
#include "modrig/loader/LoadedApplications.h"

namespace bench
{
namespace
{
constexpr const char* kEntry = "tsrxEntryPoint";

bool callEntry(void* entry, unsigned message = TSRX_MSG_LOAD)
{
    return entry && reinterpret_cast<TsRxEntryPoint>(entry)(message, nullptr) == TSRX_RET_OK;
}

class Bare
{
public:
    explicit Bare(const Paths& paths) : mPaths(paths) { mModules.reserve(paths.size()); }

    bool loadAll()
    {
        return std::ranges::all_of(mPaths, [this](const std::string& path) { return load(path); });
    }
    bool unloadAll() { return std::ranges::all_of(mModules, unload); }

private:
    struct Module
    {
        void* library;
        void* entry;
    };

    bool load(const std::string& path)
    {
        void* library = dlopen(path.c_str(), RTLD_NOW | RTLD_LOCAL);
        mModules.push_back({library, library ? dlsym(library, kEntry) : nullptr});
        return callEntry(mModules.back().entry);
    }
    static bool unload(const Module& module)
    {
        return callEntry(module.entry, TSRX_MSG_UNLOAD) && dlclose(module.library) == 0;
    }

    const Paths& mPaths;
    std::vector<Module> mModules;
};

class ByGModule
{
public:
    explicit ByGModule(const Paths& paths) : mPaths(paths) {}

    bool loadAll() { return std::ranges::all_of(mPaths, load); }

private:
    static bool load(const std::string& path)
    {
        GModule* library = g_module_open(path.c_str(), G_MODULE_BIND_LOCAL);
        gpointer entry = nullptr;
        return library && g_module_symbol(library, kEntry, &entry) && callEntry(entry);
    }

    const Paths& mPaths;
};

class ByQLibrary
{
public:
    explicit ByQLibrary(const Paths& paths) : mPaths(paths) {}

    bool loadAll() { return std::ranges::all_of(mPaths, load); }

private:
    static bool load(const std::string& path)
    {
        QLibrary library(QString::fromStdString(path));
        library.setLoadHints(QLibrary::ResolveAllSymbolsHint);
        return library.load() && callEntry(reinterpret_cast<void*>(library.resolve(kEntry)));
    }

    const Paths& mPaths;
};

// It has no way to have everything resolved at once; of a module this small nothing is left to be resolved.
class ByLibltdl
{
public:
    explicit ByLibltdl(const Paths& paths) : mPaths(paths), mIsThere(lt_dlinit() == 0) {}

    bool loadAll() { return mIsThere && std::ranges::all_of(mPaths, load); }

private:
    static bool load(const std::string& path)
    {
        const lt_dlhandle library = lt_dlopen(path.c_str());
        return library && callEntry(lt_dlsym(library, kEntry));
    }

    const Paths& mPaths;
    bool mIsThere;
};

std::vector<std::wstring> allWide(const Paths& paths)
{
    std::vector<std::wstring> result;
    std::ranges::transform(paths, std::back_inserter(result), wide);
    return result;
}

class ByHostLinker
{
public:
    explicit ByHostLinker(const Paths& paths) : mPaths(allWide(paths)) {}

    bool loadAll()
    {
        return std::ranges::all_of(mPaths, [](const std::wstring& path)
                                   { return linker() && linker()->loadModule(path.c_str(), true, true); });
    }
    bool unloadAll()
    {
        return std::ranges::all_of(mPaths, [](const std::wstring& path)
                                   { return linker() && linker()->unloadModule(path.c_str(), true); });
    }

private:
    static TsRxDynamicLinker* linker()
    {
        return TsRxDynamicLinker::cast(tsrxSysRegistry()->at(TSRX_DYNAMIC_LINKER));
    }

    std::vector<std::wstring> mPaths;
};

class ByModrig
{
public:
    explicit ByModrig(const Paths& paths)
    {
        for (const std::wstring& path : allWide(paths))
            mApplications.push_back({path, true});
    }

    bool loadAll()
    {
        return std::ranges::all_of(
            mApplications, [](const ModrigUtils::UnloadCandidate& application)
            { return ModrigUtils::PerformModrig(application.path, 0, 1, 1) == ModrigUtils::kLoaded; });
    }
    bool unloadAll()
    {
        std::size_t unloaded = 0;
        ModrigUtils::UnloadApplications(mApplications, [&](std::size_t) { ++unloaded; });
        return unloaded == mApplications.size();
    }

private:
    std::vector<ModrigUtils::UnloadCandidate> mApplications;
};

double secondsIfDone(const std::function<bool()>& work)
{
    bool done = false;
    const double seconds = secondsOf([&] { done = work(); });
    return done ? seconds : -1;
}

template <class Way>
double secondsToLoadBy(const Paths& modules)
{
    Way way(modules);
    return secondsIfDone([&] { return way.loadAll(); });
}

template <class Way>
double secondsToUnloadBy(const Paths& modules)
{
    Way way(modules);
    return way.loadAll() ? secondsIfDone([&] { return way.unloadAll(); }) : -1;
}
} // namespace

const std::vector<Loader>& loaders()
{
    static const std::vector<Loader> all = {
        {kBare, secondsToLoadBy<Bare>, secondsToUnloadBy<Bare>},
        {kGModule, secondsToLoadBy<ByGModule>, nullptr},
        {kQLibrary, secondsToLoadBy<ByQLibrary>, nullptr},
        {kLibltdl, secondsToLoadBy<ByLibltdl>, nullptr},
        {kHostLinker, secondsToLoadBy<ByHostLinker>, secondsToUnloadBy<ByHostLinker>},
        {kPerformModrig, secondsToLoadBy<ByModrig>, secondsToUnloadBy<ByModrig>}};
    return all;
}
} // namespace bench
