// Runs the benchmarks group by group, each group in a process of its own: what one group leaves in memory
// would otherwise be part of what the next one measures, above all where it measures in children of its
// process.
#include <sys/wait.h>
#include <unistd.h>

#include <cstdio>
#include <cstring>

#include "bench/Ratios.h"

void addLoadingBenchmarks();
void addListBenchmarks();
void addRebuildBenchmarks();
void addStartBenchmarks();

namespace
{
struct Group
{
    const char* name;
    void (*add)();
};

constexpr Group kGroups[] = {{"loading", addLoadingBenchmarks},
                             {"lists", addListBenchmarks},
                             {"rebuild", addRebuildBenchmarks},
                             {"start", addStartBenchmarks}};

int runGroup(const char* name, int argc, char** argv)
{
    for (const Group& group : kGroups)
    {
        if (std::strcmp(group.name, name) != 0)
            continue;
        group.add();
        return bench::runAll(argc, argv) == 0 ? 0 : 1;
    }
    std::fprintf(stderr, "there is no group of benchmarks called %s\n", name);
    return 2;
}

// True when the group ran and missed no limit.
bool runInProcess(const Group& group, char* program)
{
    std::fflush(stdout);
    const pid_t child = fork();
    if (child == 0)
    {
        execl(program, program, group.name, static_cast<char*>(nullptr));
        _exit(2);
    }
    int ended = 1;
    return child > 0 && waitpid(child, &ended, 0) == child && ended == 0;
}
} // namespace

int main(int argc, char** argv)
{
    if (argc > 1)
    {
        // The name of the group is this program's; what follows is the library's.
        return runGroup(argv[1], argc - 1, argv + 1);
    }
    bool all = true;
    for (const Group& group : kGroups)
        all = runInProcess(group, argv[0]) && all;
    return all ? 0 : 1;
}
