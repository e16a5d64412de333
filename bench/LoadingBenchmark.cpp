// Loading 500 compiled modules: the module's loader against the host's linker, the bare system calls, and the
// module loaders of two toolkits. Every run is a new process, since a library is mapped for the first time
// once.
#include <benchmark/benchmark.h>
#include <dlfcn.h>
#include <gmodule.h>
#include <tessel/tsrxlinker.h>

#include <QLibrary>
#include <functional>
#include <string>
#include <vector>

#include "bench/Child.h"
#include "bench/Ratios.h"
#include "bench/Session.h"
#include "loader/ApplicationLoader.h"
#include "module/Globals.h"

namespace
{
constexpr int kModules = 500;
constexpr int kRepetitions = 15;
constexpr const char* kEntry = "tsrxEntryPoint";

const std::vector<std::string>& modules()
{
    static const std::vector<std::string> paths = []
    {
        std::vector<std::string> made;
        const auto folder = bench::workFolder() / "modules";
        std::filesystem::create_directories(folder);
        for (int i = 0; i < kModules; ++i)
        {
            made.push_back((folder / ("module" + std::to_string(i) + ".zmb")).string());
            std::filesystem::copy_file(BENCH_MODULE, made.back());
        }
        return made;
    }();
    return paths;
}

std::vector<std::wstring> widePaths()
{
    std::vector<std::wstring> wide;
    for (const std::string& path : modules())
        wide.emplace_back(path.begin(), path.end()); // the folder's name is plain
    return wide;
}

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
double secondsForAll(const std::vector<Path>& paths, const std::function<bool(const Path&)>& load)
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

template <class Path>
void measure(const char* name, std::vector<Path> paths, std::function<bool(const Path&)> load)
{
    const auto run = [paths = std::move(paths), load = std::move(load)](benchmark::State& state)
    {
        for (auto iteration : state)
        {
            static_cast<void>(iteration);
            const double seconds = bench::inChild([&] { return secondsForAll<Path>(paths, load); });
            if (seconds < 0)
                state.SkipWithError("not every module was loaded");
            state.SetIterationTime(seconds);
        }
    };
    benchmark::RegisterBenchmark(name, run)->UseManualTime()->Iterations(1)->Repetitions(kRepetitions);
}
} // namespace

void addLoadingBenchmarks()
{
    bench::startHost();
    measure<std::string>("load 500: bare dlopen and entry", modules(), loadBare);
    measure<std::string>("load 500: GModule", modules(), loadByGModule);
    measure<std::string>("load 500: QLibrary", modules(), loadByQLibrary);
    measure<std::wstring>("load 500: host linker", widePaths(), loadByHostLinker);
    measure<std::wstring>("load 500: PerformModrig", widePaths(), loadByModrig);
    bench::addRatio({"PerformModrig / host linker, 500 modules", "load 500: PerformModrig",
                     "load 500: host linker", 1.05});
    bench::addRatio({"PerformModrig / bare dlopen and entry", "load 500: PerformModrig",
                     "load 500: bare dlopen and entry", 1.3});
    bench::addRatio({"PerformModrig / QLibrary", "load 500: PerformModrig", "load 500: QLibrary", 1.0});
    bench::addRatio({"PerformModrig / GModule", "load 500: PerformModrig", "load 500: GModule"});
    bench::addRatio(
        {"QLibrary / bare dlopen and entry", "load 500: QLibrary", "load 500: bare dlopen and entry"});
}
