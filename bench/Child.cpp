#include "bench/Child.h"

#include <sys/wait.h>
#include <unistd.h>

#include <cstdio>
#include <filesystem>
#include <map>

#include "bench/Counting.h"
#include "bench/ProcessorTime.h"

namespace bench
{
namespace
{
constexpr double kNotCounted = -1;

// What a child writes into its parent's pipe.
struct Cost
{
    double seconds = -1;
    double instructions = kNotCounted;
};

std::map<double, double>& instructionsBySeconds()
{
    static std::map<double, double> all;
    return all;
}

double remembered(const Cost& cost)
{
    if (cost.instructions != kNotCounted)
        instructionsBySeconds()[cost.seconds] = cost.instructions;
    return cost.seconds;
}
} // namespace

double secondsOf(const std::function<void()>& work)
{
    InstructionCounter counter;
    const double start = processorSeconds();
    work();
    const double seconds = processorSeconds() - start;
    return remembered({seconds, counter.stop().value_or(kNotCounted)});
}

std::optional<double> instructionsOf(double seconds)
{
    const auto found = instructionsBySeconds().find(seconds);
    return found == instructionsBySeconds().end() ? std::nullopt : std::optional(found->second);
}

double inChild(const std::function<double()>& work)
{
    const CountElsewhere elsewhere;
    int ends[2];
    if (pipe(ends) != 0)
        return -1;
    const pid_t child = fork();
    if (child == 0)
    {
        const double seconds = work();
        const Cost cost = {seconds, instructionsOf(seconds).value_or(kNotCounted)};
        const bool told = write(ends[1], &cost, sizeof cost) == sizeof cost;
        _exit(told ? 0 : 1); // no destructors: the parent's files and libraries are not the child's to end
    }
    close(ends[1]);
    Cost cost;
    if (child < 0 || read(ends[0], &cost, sizeof cost) != sizeof cost)
        cost = {};
    close(ends[0]);
    if (child > 0)
        waitpid(child, nullptr, 0);
    return remembered(cost);
}

double inNewProcess(const std::vector<std::string>& arguments)
{
    const CountElsewhere elsewhere;
    std::string command = std::filesystem::read_symlink("/proc/self/exe").string();
    for (const std::string& argument : arguments)
        command += " '" + argument + "'";
    FILE* output = popen(command.c_str(), "r");
    if (!output)
        return -1;
    Cost cost;
    const bool told = std::fscanf(output, "%lf %lf", &cost.seconds, &cost.instructions) >= 1;
    const bool endedWell = pclose(output) == 0;
    return told && endedWell ? remembered(cost) : -1;
}

void tellSeconds(double seconds)
{
    std::printf("%.9f", seconds);
    if (const auto instructions = instructionsOf(seconds))
        std::printf(" %.0f", *instructions);
    std::printf("\n");
}
} // namespace bench
