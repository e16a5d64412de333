// What the runs of the benchmarks come to: figures, how far they wobbled, and which limits they miss.
// Arithmetic alone, nothing is run here.
#pragma once

#include <functional>
#include <map>
#include <set>
#include <string>
#include <vector>

#include "bench/Ratios.h"

namespace bench
{
// What each run of a benchmark has cost.
struct Samples
{
    std::vector<double> seconds;
    std::vector<double> instructions; // empty where nothing counts them

    const std::vector<double>& of(By by) const { return by == kInstructions ? instructions : seconds; }
};

using SamplesByName = std::map<std::string, Samples>;

// A value of 0 says that nothing was measured. The wobble is what the value may be off by to either side:
// half of the distance between the quartiles.
struct Measured
{
    double value = 0;
    double wobble = 0;
};

// The mean of both values in the middle where there are two; 0 of none.
double median(std::vector<double> values);

Measured measuredOf(const std::vector<double>& values);

// The medians' ratio, by what is asked for. Its wobble is that of the ratios of those runs of both that had
// the same place in the whole run: what slows the machine for a while slows both.
Measured measuredRatio(const Ratio& ratio, const SamplesByName& samples, By by);

// What was not measured misses every limit. A limit of 0 is none.
bool isMissed(const Measured& measured, double most);

// Whether the limit is no further away than the value wobbles.
bool isInDoubt(const Measured& measured, double most);

constexpr int kMostRunsAgain = 3;

// Has the benchmarks of all ratios that are in doubt run again, and again while some are, but not more than
// that many times. `runAgain` adds to the samples.
void runWhileInDoubt(const std::vector<Ratio>& ratios, const SamplesByName& samples,
                     const std::function<void(const std::set<std::string>& names)>& runAgain);
} // namespace bench
