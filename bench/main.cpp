// Runs one group of the benchmarks that need no display: modrig_bench GROUP. Ends non-zero when a limit is
// missed. For each of its runs the loading group starts it again: modrig_bench load|unload LOADER FOLDER
// COUNT tells seconds. tools/bench and the build system read the groups out of the table below.
#include <cstdio>
#include <cstring>
#include <string>

#include "bench/Child.h"
#include "bench/Ratios.h"

void addLoadingBenchmarks();
double secondsOfModules(const std::string& deed, const std::string& loader, const std::string& folder,
                        std::size_t count);
void addListBenchmarks();
void addRebuildBenchmarks();
void addStartBenchmarks();

namespace
{
constexpr int kUsage = 2;

struct Group
{
    const char* name;
    void (*add)();
};

// Starts come first: they are mostly the system's work, which is slower for a while after lists of a million
// have come and gone.
constexpr Group kGroups[] = {{"start", addStartBenchmarks},
                             {"loading", addLoadingBenchmarks},
                             {"lists", addListBenchmarks},
                             {"rebuild", addRebuildBenchmarks}};
} // namespace

int main(int argc, char** argv)
{
    if (argc == 5)
    {
        const double seconds = secondsOfModules(argv[1], argv[2], argv[3], std::stoul(argv[4]));
        bench::tellSeconds(seconds);
        return seconds < 0 ? 1 : 0;
    }
    const char* wanted = argc == 2 ? argv[1] : "";
    for (const Group& group : kGroups)
    {
        if (std::strcmp(group.name, wanted) != 0)
            continue;
        group.add();
        return bench::runAll() == 0 ? 0 : 1;
    }
    std::fprintf(stderr, "There is no group of benchmarks called \"%s\".\n", wanted);
    return kUsage;
}
