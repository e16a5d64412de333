// Loading and unloading compiled modules. Every run is a new process, since a library is mapped for the first
// time once; and a whole one with a host of its own, since a fork would pay for every page of memory that it
// is the first to write to.
#include <benchmark/benchmark.h>

#include <algorithm>
#include <string>
#include <vector>

#include "bench/Child.h"
#include "bench/Loaders.h"
#include "bench/Ratios.h"
#include "bench/Session.h"

namespace
{
using namespace bench;

constexpr std::size_t kModules = 500;
constexpr std::size_t kManyModules = 1'000;
constexpr std::size_t kMostModules = 10'000; // the system allows a process no more than some 13,000
constexpr int kRepetitions = 15;
constexpr int kRepetitionsOfMost = 7; // of which each takes seconds

constexpr const char* kLoad = "load";
constexpr const char* kUnload = "unload";

std::string benchmarkOf(const std::string& deed, const std::string& loader, std::size_t count)
{
    return deed + " " + std::to_string(count) + ": " + loader;
}

void add(const std::string& deed, const std::string& loader, std::size_t count)
{
    const std::string folder = folderOfModules("modules", count).string();
    const auto run = [=](benchmark::State& state)
    {
        for (auto iteration : state)
        {
            static_cast<void>(iteration);
            const double seconds = inNewProcess({deed, loader, folder, std::to_string(count)});
            if (seconds < 0)
                state.SkipWithError("not every module was loaded, or unloaded");
            state.SetIterationTime(seconds);
        }
    };
    benchmark::RegisterBenchmark(benchmarkOf(deed, loader, count).c_str(), run)
        ->UseManualTime()
        ->Iterations(1)
        ->Repetitions(count == kMostModules ? kRepetitionsOfMost : kRepetitions);
}

void addComparison(const std::string& deed, std::size_t count, const std::string& base, double most)
{
    addRatio({deed + " " + std::to_string(count) + ": " + kPerformModrig + " / " + base,
              benchmarkOf(deed, kPerformModrig, count), benchmarkOf(deed, base, count), most});
}

// How much of it is the system's own: its linker walks the list of all libraries for each one.
void addGrowth(const std::string& loader)
{
    addRatio({"load: " + loader + ", per module of 10000 / of 1000", benchmarkOf(kLoad, loader, kMostModules),
              benchmarkOf(kLoad, loader, kManyModules), 0, kMostModules, kManyModules});
}
} // namespace

double secondsOfModules(const std::string& deed, const std::string& loader, const std::string& folder,
                        std::size_t count)
{
    const auto known = std::ranges::find(loaders(), loader, &Loader::name);
    if (known == loaders().end())
        return -1;
    const auto work = deed == kLoad ? known->secondsToLoad : known->secondsToUnload;
    Paths modules;
    for (std::size_t i = 0; i < count; ++i)
        modules.push_back(moduleIn(folder, i).string());
    startHost();
    return work ? work(modules) : -1;
}

void addLoadingBenchmarks()
{
    for (const Loader& loader : loaders())
        add(kLoad, loader.name, kModules);
    for (const std::size_t count : {kManyModules, kMostModules})
        for (const char* loader : {kBare, kPerformModrig})
            add(kLoad, loader, count);
    for (const char* loader : {kBare, kPerformModrig})
        add(kUnload, loader, kModules);
    addComparison(kLoad, kModules, kHostLinker, 1.05);
    addComparison(kLoad, kModules, kBare, 1.3);
    addComparison(kLoad, kModules, kGModule, 0);
    addComparison(kLoad, kModules, kQLibrary, 1.0);
    addComparison(kLoad, kModules, kLibltdl, 0);
    addComparison(kLoad, kMostModules, kBare, 1.2);
    addGrowth(kBare);
    addGrowth(kPerformModrig);
    addComparison(kUnload, kModules, kBare, 1.3);
}
