// Ratios between benchmarks of one run: what the limits are stated in, since machines differ and are shared.
#pragma once

#include <string>

namespace bench
{
// What a ratio is judged by. Instructions of the processor do not wobble, but say nothing of caches and
// waiting. Where the machine does not count them, Valgrind does.
enum By
{
    kProcessorTime,
    kInstructions
};

// One line of the table: how many times as much `measured` takes as `base`, each divided by its number of
// units (entries, files), and the most that this may be; 0 for no limit.
struct Ratio
{
    std::string what;
    std::string measured;
    std::string base;
    double most = 0;
    double measuredUnits = 1;
    double baseUnits = 1;
    By by = kProcessorTime;
    // What the names do not say of how it is measured, or why: sentences for docs/performance.md.
    std::string how = {};
};

// `source` is the file that the figure stands in.
void addRatio(Ratio ratio, const char* source = __builtin_FILE());

// A figure that is no time, for the same table. `how` is that of a ratio.
void addFigure(const std::string& what, double value, const std::string& unit, double most,
               const std::string& how = {}, const char* source = __builtin_FILE());

// How many repetitions a benchmark has that usually has so many: fewer in a quick run, and one when it is
// counted.
int repetitions(int usual);

// Runs every registered benchmark, its repetitions interleaved with the others' in random order; those of a
// ratio that is within its wobble of its limit are run again. Prints the medians and the table. Answers the
// number of limits that were missed and of benchmarks that failed.
int runAll();
} // namespace bench
