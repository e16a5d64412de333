#include "bench/Ratios.h"

#include <benchmark/benchmark.h>
#include <fnmatch.h>

#include <algorithm>
#include <cstdio>
#include <set>
#include <vector>

#include "bench/Child.h"
#include "bench/Counting.h"
#include "bench/Judging.h"
#include "bench/Report.h"
#include "bench/Wishes.h"

namespace bench
{
namespace
{
constexpr int kQuickRepetitions = 3;
// By Valgrind, of each benchmark: addresses differ from run to run, and instructions a little.
constexpr int kCounts = 3;
const std::string kEveryBenchmark = ".";

struct SourcedRatio
{
    Ratio ratio;
    std::string source;
};

std::vector<SourcedRatio>& ratios()
{
    static std::vector<SourcedRatio> all;
    return all;
}

std::vector<Figure>& figures()
{
    static std::vector<Figure> all;
    return all;
}

// Times that the library takes itself are processor time too, like those that the benchmarks measure.
double timeOf(const benchmark::BenchmarkReporter::Run& run)
{
    const bool measuredByBenchmark = run.run_name.time_type == "manual_time";
    return measuredByBenchmark ? run.real_accumulated_time : run.cpu_accumulated_time;
}

// Keeps what every repetition has cost, by benchmark.
class Collector : public benchmark::BenchmarkReporter
{
public:
    bool ReportContext(const Context&) override { return true; }
    void ReportRuns(const std::vector<Run>& runs) override
    {
        for (const Run& run : runs)
            if (run.error_occurred)
                reportFailure(run);
            else if (run.run_type == Run::RT_Iteration && run.iterations > 0)
                keep(run);
    }

    SamplesByName& samples() { return mSamples; }
    int failed() const { return static_cast<int>(mFailed.size()); }

private:
    void keep(const Run& run)
    {
        Samples& samples = mSamples[run.run_name.function_name];
        samples.seconds.push_back(timeOf(run) / static_cast<double>(run.iterations));
        if (const auto instructions = instructionsOf(timeOf(run)))
            samples.instructions.push_back(*instructions);
    }

    void reportFailure(const Run& run)
    {
        if (mFailed.insert(run.run_name.function_name).second)
            std::printf("%s: %s\n", run.run_name.function_name.c_str(), run.error_message.c_str());
    }

    SamplesByName mSamples;
    std::set<std::string> mFailed;
};

bool isWanted(const std::string& what)
{
    const std::string& only = wishes().only;
    return only.empty() || fnmatch(("*" + only + "*").c_str(), what.c_str(), FNM_CASEFOLD) == 0;
}

std::vector<Ratio> wantedRatios()
{
    std::vector<Ratio> wanted;
    for (const SourcedRatio& each : ratios())
        if (isWanted(each.ratio.what))
            wanted.push_back(each.ratio);
    return wanted;
}

std::string quoted(const std::string& name)
{
    std::string pattern;
    for (const char letter : name)
    {
        if (std::string(".^$*+?()[]{}|\\").find(letter) != std::string::npos)
            pattern += '\\';
        pattern += letter;
    }
    return pattern;
}

// The library's filter for these benchmarks; it adds to their names how they are run, after a slash.
std::string filterFor(const std::set<std::string>& names)
{
    std::string filter;
    for (const std::string& name : names)
        filter += (filter.empty() ? "^(" : "|") + quoted(name);
    return filter + ")(/|$)";
}

std::set<std::string> namesOf(const std::vector<Ratio>& wanted)
{
    std::set<std::string> names;
    for (const Ratio& ratio : wanted)
        names.insert({ratio.measured, ratio.base});
    return names;
}

// Where the machine does not count, Valgrind does, for what is judged by it.
void count(std::vector<Ratio> wanted, SamplesByName& samples)
{
    if (whyNothingCounts().empty())
        return;
    std::erase_if(wanted, [](const Ratio& ratio) { return ratio.by != kInstructions; });
    for (const std::string& name : namesOf(wanted))
        for (int i = 0; i < repetitions(kCounts); ++i)
            if (const auto instructions = countByValgrind(name))
                samples[name].instructions.push_back(*instructions);
}

void run(const std::string& filter, Collector& collector)
{
    benchmark::RunSpecifiedBenchmarks(&collector, filter);
}

void runAgain(std::vector<Ratio> wanted, const std::set<std::string>& names, Collector& collector)
{
    std::printf("\nWithin its wobble of its limit, so run again:\n");
    for (const std::string& name : names)
        std::printf("    %s\n", name.c_str());
    run(filterFor(names), collector);
    std::erase_if(wanted, [&](const Ratio& ratio) { return !names.contains(ratio.measured); });
    count(wanted, collector.samples());
}

void runWanted(const std::vector<Ratio>& wanted, Collector& collector)
{
    if (wishes().only.empty())
        run(kEveryBenchmark, collector);
    else if (!wanted.empty())
        run(filterFor(namesOf(wanted)), collector);
    count(wanted, collector.samples());
    if (wishes().quick)
        return;
    runWhileInDoubt(wanted, collector.samples(),
                    [&](const std::set<std::string>& names) { runAgain(wanted, names, collector); });
}

Figure figureOf(const SourcedRatio& each, const SamplesByName& samples)
{
    const Ratio& ratio = each.ratio;
    return {.what = ratio.what,
            .unit = "x",
            .measured = measuredRatio(ratio, samples, ratio.by),
            .most = ratio.most,
            .by = ratio.by,
            .instructions = measuredRatio(ratio, samples, kInstructions),
            .time = measuredRatio(ratio, samples, kProcessorTime),
            .measuredName = ratio.measured,
            .baseName = ratio.base,
            .measuredUnits = ratio.measuredUnits,
            .baseUnits = ratio.baseUnits,
            .how = ratio.how,
            .source = each.source};
}

std::vector<Figure> wantedFigures(const SamplesByName& samples)
{
    std::vector<Figure> all;
    for (const SourcedRatio& each : ratios())
        if (isWanted(each.ratio.what))
            all.push_back(figureOf(each, samples));
    for (const Figure& figure : figures())
        if (isWanted(figure.what))
            all.push_back(figure);
    return all;
}

void initializeLibrary()
{
    std::string program = "bench";
    std::string interleaving = "--benchmark_enable_random_interleaving=true";
    char* arguments[] = {program.data(), interleaving.data()};
    int count = 2;
    benchmark::Initialize(&count, arguments);
}

// Valgrind counts, and its file is the answer.
int runForCounting()
{
    Collector collector;
    countNextWork();
    run(filterFor({wishes().count}), collector);
    return collector.failed();
}

int report(Collector& collector)
{
    const SamplesByName& samples = collector.samples();
    const std::vector<Figure> all = wantedFigures(samples);
    printMedians(samples);
    const int missed = printFigures(all, !wishes().quick);
    const std::string& results = wishes().results;
    const bool written = results.empty() || writeFigures(all, samples, results);
    if (!written)
        std::fprintf(stderr, "The figures cannot be written to %s.\n", results.c_str());
    return missed + collector.failed() + (written ? 0 : 1);
}
} // namespace

void addRatio(Ratio ratio, const char* source)
{
    ratios().push_back({std::move(ratio), source});
}

void addFigure(const std::string& what, double value, const std::string& unit, double most,
               const std::string& how, const char* source)
{
    figures().push_back(
        {.what = what, .unit = unit, .measured = {value, 0}, .most = most, .how = how, .source = source});
}

int repetitions(int usual)
{
    if (!wishes().count.empty())
        return 1;
    return wishes().quick ? std::min(usual, kQuickRepetitions) : usual;
}

int runAll()
{
    initializeLibrary();
    if (!wishes().count.empty())
        return runForCounting();
    Collector collector;
    runWanted(wantedRatios(), collector);
    return report(collector);
}
} // namespace bench
