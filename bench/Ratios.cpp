#include "bench/Ratios.h"

#include <benchmark/benchmark.h>

#include <algorithm>
#include <cstdio>
#include <map>
#include <vector>

namespace bench
{
namespace
{
struct Figure
{
    std::string what;
    double value;
    std::string unit;
    double most;
};

std::vector<Ratio>& ratios()
{
    static std::vector<Ratio> all;
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

// Keeps every repetition's time in seconds by benchmark.
class Collector : public benchmark::BenchmarkReporter
{
public:
    bool ReportContext(const Context&) override { return true; }
    void ReportRuns(const std::vector<Run>& runs) override
    {
        for (const Run& run : runs)
            if (run.run_type == Run::RT_Iteration && !run.error_occurred && run.iterations > 0)
                mTimes[run.run_name.function_name].push_back(timeOf(run) /
                                                             static_cast<double>(run.iterations));
            else if (run.error_occurred)
                std::printf("%s: %s\n", run.benchmark_name().c_str(), run.error_message.c_str());
    }

    double median(const std::string& name)
    {
        std::vector<double>& times = mTimes[name];
        if (times.empty())
            return 0;
        std::sort(times.begin(), times.end());
        return times[times.size() / 2];
    }

    void printMedians()
    {
        std::printf("\n%-58s %12s %6s\n", "benchmark", "median ms", "runs");
        for (const auto& [name, times] : mTimes)
            std::printf("%-58s %12.3f %6zu\n", name.c_str(), median(name) * 1e3, times.size());
    }

private:
    std::map<std::string, std::vector<double>> mTimes;
};

// Answers 1 when the limit is missed.
int printRow(const std::string& what, double value, const std::string& unit, double most)
{
    const bool missed = most > 0 && (value > most || value <= 0);
    const std::string limit = most > 0 ? std::to_string(most).substr(0, 5) : "-";
    const std::string shown = std::to_string(value).substr(0, 6) + " " + unit;
    std::printf("%-66s %12s %8s  %s\n", what.c_str(), shown.c_str(), limit.c_str(), missed ? "MISSED" : "ok");
    return missed ? 1 : 0;
}

int printTable(Collector& collector)
{
    int missed = 0;
    std::printf("\n%-66s %12s %8s\n", "ratio or figure", "value", "at most");
    for (const Ratio& ratio : ratios())
    {
        const double measured = collector.median(ratio.measured) / ratio.measuredUnits;
        const double base = collector.median(ratio.base) / ratio.baseUnits;
        missed += printRow(ratio.what, base > 0 ? measured / base : 0, "x", ratio.most);
    }
    for (const Figure& figure : figures())
        missed += printRow(figure.what, figure.value, figure.unit, figure.most);
    return missed;
}
} // namespace

void addRatio(Ratio ratio)
{
    ratios().push_back(std::move(ratio));
}

void addFigure(const std::string& what, double value, const std::string& unit, double most)
{
    figures().push_back({what, value, unit, most});
}

int runAll()
{
    std::string program = "bench";
    std::string interleaving = "--benchmark_enable_random_interleaving=true";
    char* arguments[] = {program.data(), interleaving.data()};
    int count = 2;
    benchmark::Initialize(&count, arguments);
    Collector collector;
    benchmark::RunSpecifiedBenchmarks(&collector);
    collector.printMedians();
    return printTable(collector);
}
} // namespace bench
