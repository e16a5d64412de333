// Rebuilding the list of loaded applications, and validating paths.
#include <benchmark/benchmark.h>
#include <tessel/tsed.h>
#include <tessel/tsrxlinker.h>
#include <wincompat/winfile.h>

#include <filesystem>
#include <fstream>
#include <string>
#include <vector>

#include "bench/Child.h"
#include "bench/Ratios.h"
#include "bench/Session.h"
#include "modrig/lists/Globals.h"
#include "modrig/loader/LoadedApplications.h"
#include "modrig/types/FileValidation.h"

namespace
{
constexpr int kFewModules = 100;
constexpr int kManyModules = 1'000;
constexpr int kMostModules = 10'000;
constexpr int kLispFilesPerModule = 10;
constexpr int kPaths = 1'000;
constexpr int kRebuildRepetitions = 9;
constexpr int kPathRepetitions = 31;  // of the file system, which wobbles
constexpr int kRepetitionsOfMost = 5; // before each of which the modules are loaded for seconds

// Whether all of them were loaded.
bool loadModules(int count)
{
    const auto folder = bench::folderOfModules("rebuild", static_cast<std::size_t>(count));
    TsRxDynamicLinker* linker = TsRxDynamicLinker::cast(tsrxSysRegistry()->at(TSRX_DYNAMIC_LINKER));
    bool all = true;
    for (int i = 0; i < count; ++i)
    {
        const auto path = bench::moduleIn(folder, static_cast<std::size_t>(i));
        all = linker->loadModule(bench::wide(path).c_str(), true, true) && all;
    }
    return all;
}

void loadLispFiles(int count)
{
    const auto folder = bench::workFolder() / "rebuild";
    for (int i = 0; i < count; ++i)
    {
        const auto path = folder / ("tool" + std::to_string(i) + ".lsp");
        std::ofstream(path) << "t";
        qxr_queueexpr((L"(load \"" + bench::wide(path) + L"\")").c_str());
    }
    bench::endCommand();
}

// Seconds, negative when the list does not hold then what was loaded.
double rebuild(int modules, int lispFiles)
{
    const bool loaded = loadModules(modules);
    loadLispFiles(lispFiles);
    const double seconds = bench::secondsOf(ModrigUtils::PopulateLoadedApps);
    const auto listed = static_cast<int>(gLoadedAppList.GetCount());
    return loaded && listed == modules + lispFiles ? seconds : -1;
}

// In a child: what is loaded for one size must not be there for the other.
void addRebuild(const std::string& name, int modules, int lispFiles)
{
    benchmark::RegisterBenchmark(name.c_str(),
                                 [modules, lispFiles](benchmark::State& state)
                                 {
                                     for (auto iteration : state)
                                     {
                                         static_cast<void>(iteration);
                                         const double seconds = bench::inChild(
                                             [modules, lispFiles] { return rebuild(modules, lispFiles); });
                                         if (seconds < 0)
                                             state.SkipWithError("not everything was loaded and listed");
                                         state.SetIterationTime(seconds);
                                     }
                                 })
        ->UseManualTime()
        ->Iterations(1)
        ->Repetitions(bench::repetitions(modules == kMostModules ? kRepetitionsOfMost : kRebuildRepetitions));
}

const std::vector<CStdStr>& existingPaths()
{
    static const std::vector<CStdStr> paths = []
    {
        std::vector<CStdStr> made;
        const auto folder = bench::workFolder() / "paths";
        std::filesystem::create_directories(folder);
        for (int i = 0; i < kPaths; ++i)
        {
            const auto path = folder / ("tool" + std::to_string(i) + ".lsp");
            std::ofstream(path) << "t";
            made.emplace_back(bench::wide(path));
        }
        return made;
    }();
    return paths;
}

// `check` answers whether the path is there.
template <class Check>
void addValidation(const std::string& name, Check check)
{
    benchmark::RegisterBenchmark(name.c_str(),
                                 [check](benchmark::State& state)
                                 {
                                     bool all = true;
                                     for (auto iteration : state)
                                     {
                                         static_cast<void>(iteration);
                                         for (const CStdStr& path : existingPaths())
                                             all = check(path) && all;
                                     }
                                     if (!all)
                                         state.SkipWithError("a path is not there");
                                 })
        ->Repetitions(bench::repetitions(kPathRepetitions))
        ->MinTime(0.05);
}
} // namespace

void addRebuildBenchmarks()
{
    bench::startHost();
    existingPaths(); // made here, or the first run would pay for it
    const std::string few = "rebuild with 100 modules, 1000 applications";
    const std::string many = "rebuild with 1000 modules, 10000 applications";
    const std::string manyAlone = "rebuild with 1000 modules";
    const std::string mostAlone = "rebuild with 10000 modules";
    addRebuild(few, kFewModules, kFewModules * kLispFilesPerModule);
    addRebuild(many, kManyModules, kManyModules * kLispFilesPerModule);
    addRebuild(manyAlone, kManyModules, 0);
    addRebuild(mostAlone, kMostModules, 0);
    bench::addRatio(
        {"rebuild, cost per application at 11000 / at 1100", many, few, 1.05, kManyModules, kFewModules});
    bench::addRatio({"rebuild, cost per module at 10000 / at 1000", mostAlone, manyAlone, 1.7, kMostModules,
                     kManyModules});

    const std::string bare = "validate 1000 paths, bare attribute calls";
    const std::string validated = "validate 1000 paths";
    addValidation(bare, [](const CStdStr& path)
                  { return GetFileAttributesW(path.c_str()) != INVALID_FILE_ATTRIBUTES; });
    addValidation(validated,
                  [](const CStdStr& path)
                  {
                      CStdStr found = path;
                      return ModrigUtils::ValidateFileExists(found);
                  });
    bench::addRatio({"validating 1000 existing paths / bare attribute calls", validated, bare, 1.15});
}
