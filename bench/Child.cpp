#include "bench/Child.h"

#include <sys/wait.h>
#include <unistd.h>

#include <cstdio>
#include <ctime>
#include <filesystem>

namespace bench
{
namespace
{
double processorSeconds()
{
    timespec now = {};
    clock_gettime(CLOCK_PROCESS_CPUTIME_ID, &now);
    return static_cast<double>(now.tv_sec) + static_cast<double>(now.tv_nsec) * 1e-9;
}
} // namespace

double secondsOf(const std::function<void()>& work)
{
    const double start = processorSeconds();
    work();
    return processorSeconds() - start;
}

double inChild(const std::function<double()>& work)
{
    int ends[2];
    if (pipe(ends) != 0)
        return -1;
    const pid_t child = fork();
    if (child == 0)
    {
        const double seconds = work();
        const bool told = write(ends[1], &seconds, sizeof seconds) == sizeof seconds;
        _exit(told ? 0 : 1); // no destructors: the parent's files and libraries are not the child's to end
    }
    close(ends[1]);
    double seconds = -1;
    if (child < 0 || read(ends[0], &seconds, sizeof seconds) != sizeof seconds)
        seconds = -1;
    close(ends[0]);
    if (child > 0)
        waitpid(child, nullptr, 0);
    return seconds;
}

double inNewProcess(const std::vector<std::string>& arguments)
{
    std::string command = std::filesystem::read_symlink("/proc/self/exe").string();
    for (const std::string& argument : arguments)
        command += " '" + argument + "'";
    FILE* output = popen(command.c_str(), "r");
    if (!output)
        return -1;
    double seconds = -1;
    const bool told = std::fscanf(output, "%lf", &seconds) == 1;
    const bool endedWell = pclose(output) == 0;
    return told && endedWell ? seconds : -1;
}
} // namespace bench
