// The tables that a run prints, and the same as JSON for docs/performance.md.
#pragma once

#include <string>
#include <vector>

#include "bench/Judging.h"
#include "bench/Ratios.h"

namespace bench
{
// A line of the table.
struct Figure
{
    std::string what = {};
    std::string unit = {};
    Measured measured = {};
    double most = 0;
    By by = kProcessorTime;
    Measured instructions = {}; // of a ratio that is judged by time, for information; and the other way round
    Measured time = {};
    std::string measuredName = {}; // of a ratio: its benchmarks
    std::string baseName = {};
    double measuredUnits = 1;
    double baseUnits = 1;
    std::string how = {};
    std::string source = {};
};

void printMedians(const SamplesByName& samples);

// A figure is judged only when `judged`. Answers how many limits were missed.
int printFigures(const std::vector<Figure>& figures, bool judged);

// Answers false when the file cannot be written.
bool writeFigures(const std::vector<Figure>& figures, const SamplesByName& samples, const std::string& path);
} // namespace bench
