// Ratios between benchmarks of one run: what the limits are stated in, since machines differ and are shared.
#pragma once

#include <string>

namespace bench
{
// One line of the table: how many times as long `measured` takes as `base`, each divided by its number of
// units (entries, files), and the most that this may be; 0 for no limit.
struct Ratio
{
    std::string what;
    std::string measured;
    std::string base;
    double most = 0;
    double measuredUnits = 1;
    double baseUnits = 1;
};

void addRatio(Ratio ratio);

// A figure that is no time, for the same table.
void addFigure(const std::string& what, double value, const std::string& unit, double most);

// Runs every registered benchmark, its repetitions interleaved with the others' in random order, and prints
// the medians and the table. Answers the number of limits that were missed.
int runAll();
} // namespace bench
