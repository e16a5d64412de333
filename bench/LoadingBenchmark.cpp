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

constexpr std::size_t kUsual = 500;
constexpr std::size_t kThousand = 1'000;
constexpr std::size_t kTenThousand = 10'000; // the system allows a process no more than some 13,000
constexpr int kUsualRepetitions = 15;
constexpr int kRepetitionsOfTenThousand = 7; // of which each takes seconds

constexpr const char* kUnlookedAt =
    "It maps a file without a look at it; one that was cut short ends the process.";
constexpr const char* kLoad = "load";
constexpr const char* kUnload = "unload";

std::string shown(const std::string& deed, const std::string& loader)
{
    return deed == kUnload && loader == kBare ? "bare entry and dlclose" : loader;
}

std::string benchmarkOf(const std::string& deed, const std::string& loader, std::size_t count)
{
    return deed + " " + std::to_string(count) + ": " + shown(deed, loader);
}

void add(const std::string& deed, const std::string& loader, std::size_t count)
{
    const auto run = [=](benchmark::State& state)
    {
        const std::string folder = folderOfModules("modules", count).string();
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
        ->Repetitions(repetitions(count == kTenThousand ? kRepetitionsOfTenThousand : kUsualRepetitions));
}

// Of the module's loader with another.
struct Comparison
{
    std::string deed;
    std::size_t count;
    std::string base;
    double most;
    By by = kProcessorTime;
    std::string how = {};
};

void addComparison(const Comparison& wanted)
{
    addRatio({.what = wanted.deed + " " + std::to_string(wanted.count) + " modules: " + kPerformModrig +
                      " / " + shown(wanted.deed, wanted.base),
              .measured = benchmarkOf(wanted.deed, kPerformModrig, wanted.count),
              .base = benchmarkOf(wanted.deed, wanted.base, wanted.count),
              .most = wanted.most,
              .by = wanted.by,
              .how = wanted.how});
}

void addGrowth(const std::string& loader, const std::string& how = {})
{
    addRatio({.what = "load: " + loader + ", per module of 10000 / of 1000",
              .measured = benchmarkOf(kLoad, loader, kTenThousand),
              .base = benchmarkOf(kLoad, loader, kThousand),
              .measuredUnits = kTenThousand,
              .baseUnits = kThousand,
              .how = how});
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
        add(kLoad, loader.name, kUsual);
    for (const std::size_t count : {kThousand, kTenThousand})
        for (const char* loader : {kBare, kPerformModrig})
            add(kLoad, loader, count);
    for (const char* loader : {kBare, kPerformModrig})
        add(kUnload, loader, kUsual);
    addComparison({kLoad, kUsual, kHostLinker, 1.05, kInstructions});
    addComparison(
        {kLoad, kUsual, kBare, 1.3, kProcessorTime,
         "The rest is the look at the file before its code is mapped: opening it, reading its headers, "
         "and asking the system afterwards whether it is this file that was mapped."});
    addComparison({kLoad, kUsual, kGModule, 1.2, kProcessorTime, kUnlookedAt});
    addComparison({kLoad, kUsual, kLibltdl, 1.25, kProcessorTime, kUnlookedAt});
    addComparison({kLoad, kUsual, kQLibrary, 1.0});
    addComparison(
        {kLoad, kTenThousand, kBare, 1.2, kProcessorTime,
         "For each module the system's linker walks its list of all libraries several times. Where its "
         "entries lie in memory decides whether a step of that takes 5 ns or 15 ns, for either side by "
         "chance: below 1 the base has had bad luck."});
    addGrowth(kBare, "All of it is the system's linker walking its list.");
    addGrowth(kPerformModrig, "What is added to the base does not grow.");
    addComparison({kUnload, kUsual, kBare, 1.3});
}
