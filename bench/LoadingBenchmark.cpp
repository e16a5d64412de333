// Loading 500 compiled modules: the module's loader against the host's linker, the bare system calls, and the
// module loaders of two toolkits. Every run is a new process, since a library is mapped for the first time
// once; and a whole one with a host of its own, since a fork would pay for every page of memory that it is
// the first to write to.
#include <benchmark/benchmark.h>
#include <dlfcn.h>
#include <gmodule.h>
#include <tessel/tsrxlinker.h>

#include <QLibrary>
#include <string>
#include <vector>

#include "bench/Child.h"
#include "bench/Ratios.h"
#include "bench/Session.h"
#include "modrig/lists/Globals.h"
#include "modrig/loader/ApplicationLoader.h"

namespace
{
constexpr std::size_t kModules = 500;
constexpr int kLoadingRepetitions = 15;
constexpr const char* kEntry = "tsrxEntryPoint";

bool callEntry(void* entry)
{
    return entry && reinterpret_cast<TsRxEntryPoint>(entry)(TSRX_MSG_LOAD, nullptr) == TSRX_RET_OK;
}

bool loadBare(const std::string& path)
{
    void* library = dlopen(path.c_str(), RTLD_NOW | RTLD_LOCAL);
    return library && callEntry(dlsym(library, kEntry));
}

bool loadByGModule(const std::string& path)
{
    GModule* library = g_module_open(path.c_str(), G_MODULE_BIND_LOCAL);
    gpointer entry = nullptr;
    return library && g_module_symbol(library, kEntry, &entry) && callEntry(entry);
}

bool loadByQLibrary(const std::string& path)
{
    QLibrary library(QString::fromStdString(path));
    library.setLoadHints(QLibrary::ResolveAllSymbolsHint);
    return library.load() && callEntry(reinterpret_cast<void*>(library.resolve(kEntry)));
}

bool loadByHostLinker(const std::wstring& path)
{
    TsRxDynamicLinker* linker = TsRxDynamicLinker::cast(tsrxSysRegistry()->at(TSRX_DYNAMIC_LINKER));
    return linker && linker->loadModule(path.c_str(), true, true);
}

bool loadByModrig(const std::wstring& path)
{
    return ModrigUtils::PerformModrig(path, 0, 1, 1) == ModrigUtils::kLoaded;
}

template <class Path>
double secondsForAll(const std::vector<Path>& paths, bool (*load)(const Path&))
{
    bool all = true;
    const double seconds = bench::secondsOf(
        [&]
        {
            for (const Path& path : paths)
                all = load(path) && all;
        });
    return all ? seconds : -1;
}

struct Loader
{
    const char* name;
    double (*secondsForAll)(const std::vector<std::string>& paths);
};

template <bool (*kLoad)(const std::string&)>
double secondsBy(const std::vector<std::string>& paths)
{
    return secondsForAll(paths, kLoad);
}

template <bool (*kLoad)(const std::wstring&)>
double secondsBy(const std::vector<std::string>& paths)
{
    std::vector<std::wstring> widePaths;
    widePaths.reserve(paths.size());
    for (const std::string& path : paths)
        widePaths.push_back(bench::wide(path));
    return secondsForAll(widePaths, kLoad);
}

constexpr Loader kLoaders[] = {{"bare dlopen and entry", secondsBy<loadBare>},
                               {"GModule", secondsBy<loadByGModule>},
                               {"QLibrary", secondsBy<loadByQLibrary>},
                               {"host linker", secondsBy<loadByHostLinker>},
                               {"PerformModrig", secondsBy<loadByModrig>}};

std::string benchmarkOf(const std::string& loader)
{
    return "load 500: " + loader;
}

void add(const Loader& loader, const std::string& folder)
{
    const auto run = [name = std::string(loader.name), folder](benchmark::State& state)
    {
        for (auto iteration : state)
        {
            static_cast<void>(iteration);
            const double seconds = bench::inNewProcess({"load", name, folder});
            if (seconds < 0)
                state.SkipWithError("not every module was loaded");
            state.SetIterationTime(seconds);
        }
    };
    benchmark::RegisterBenchmark(benchmarkOf(loader.name).c_str(), run)
        ->UseManualTime()
        ->Iterations(1)
        ->Repetitions(kLoadingRepetitions);
}

void addLoadingRatio(const std::string& what, const std::string& base, double most = 0)
{
    bench::addRatio({what + " / " + base + ", 500 modules", benchmarkOf(what), benchmarkOf(base), most});
}
} // namespace

double secondsToLoad(const std::string& loader, const std::string& folder)
{
    std::vector<std::string> paths;
    for (std::size_t i = 0; i < kModules; ++i)
        paths.push_back(bench::moduleIn(folder, i).string());
    bench::startHost();
    for (const Loader& known : kLoaders)
        if (loader == known.name)
            return known.secondsForAll(paths);
    return -1;
}

void addLoadingBenchmarks()
{
    const std::string folder = bench::folderOfModules("modules", kModules).string();
    for (const Loader& loader : kLoaders)
        add(loader, folder);
    addLoadingRatio("PerformModrig", "host linker", 1.05);
    addLoadingRatio("PerformModrig", "bare dlopen and entry", 1.3);
    addLoadingRatio("PerformModrig", "QLibrary", 1.0);
    addLoadingRatio("PerformModrig", "GModule");
    addLoadingRatio("QLibrary", "bare dlopen and entry");
}
