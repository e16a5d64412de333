// What the programs that show a list by another toolkit have in common: bench_qt_list and bench_gtk_list,
// each run as PROGRAM FILE DISPLAY, with a file of paths, one to a line, and the process of the display, or
// 0.
#pragma once

#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <string>
#include <vector>

#include <sys/types.h>

#include "bench/ProcessorTime.h"

namespace bench
{
inline std::vector<std::string> linesOf(const char* file)
{
    std::vector<std::string> lines;
    std::ifstream input(file);
    for (std::string line; std::getline(input, line);)
        lines.push_back(line);
    return lines;
}

inline constexpr int kPeerWidth = 640;
inline constexpr int kPeerHeight = 300;

// `show` shows a window with the lines and lets it go again; it answers whether all went well.
inline int runPeer(int argc, char** argv, bool (*show)(const std::vector<std::string>& lines))
{
    const pid_t display = argc == 3 ? static_cast<pid_t>(std::strtol(argv[2], nullptr, 10)) : 0;
    const std::vector<std::string> lines = argc == 3 ? linesOf(argv[1]) : std::vector<std::string>();
    if (lines.empty() || !show({}))
        return EXIT_FAILURE;
    const double start = processorSeconds(display);
    const bool isShown = show(lines);
    std::printf("%.9f\n", processorSeconds(display) - start);
    return isShown ? EXIT_SUCCESS : EXIT_FAILURE;
}
} // namespace bench
