// From the start of the host's process to its first prompt, against the parts that it cannot do without.
// Every run is a new process with an empty Startup Suite.
#include <benchmark/benchmark.h>
#include <fcntl.h>
#include <spawn.h>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cstdio>
#include <functional>
#include <string>
#include <vector>

#include "bench/Ratios.h"
#include "bench/Session.h"
#include "tests/support/ProgramArguments.h"

extern char** environ;

namespace
{
constexpr int kStartRepetitions = 15;

double secondsOf(const timeval& time)
{
    return static_cast<double>(time.tv_sec) + static_cast<double>(time.tv_usec) * 1e-6;
}

// Runs the program with its output thrown away. Answers the processor time that it took, or a negative number
// if it did not end well.
double runProgram(std::vector<std::string> arguments)
{
    const std::vector<char*> pointers = pointersTo(arguments);
    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    posix_spawn_file_actions_addopen(&actions, STDIN_FILENO, "/dev/null", O_RDONLY, 0);
    posix_spawn_file_actions_addopen(&actions, STDOUT_FILENO, "/dev/null", O_WRONLY, 0);
    pid_t child = 0;
    const int status = posix_spawn(&child, pointers[0], &actions, nullptr, pointers.data(), environ);
    posix_spawn_file_actions_destroy(&actions);
    int ended = 1;
    rusage used = {};
    if (status != 0 || wait4(child, &ended, 0, &used) != child || ended != 0)
        return -1;
    return secondsOf(used.ru_utime) + secondsOf(used.ru_stime);
}

std::string profileFolder(const std::string& name)
{
    return (bench::workFolder() / ("start-" + name)).string();
}

void add(const std::string& name, const std::vector<std::string>& arguments)
{
    benchmark::RegisterBenchmark(name.c_str(),
                                 [arguments](benchmark::State& state)
                                 {
                                     for (auto iteration : state)
                                     {
                                         static_cast<void>(iteration);
                                         const double seconds = runProgram(arguments);
                                         state.SetIterationTime(seconds);
                                         if (seconds < 0)
                                             state.SkipWithError("the program did not end well");
                                     }
                                 })
        ->UseManualTime()
        ->Iterations(1)
        ->Repetitions(kStartRepetitions);
}

// A start with a long History, which Modrig reads, against the parts and as many values read bare.
void addHistoryStart()
{
    const std::string count = "100000";
    const std::string profile = profileFolder("history");
    if (runProgram({START_PARTS, profile, MODRIG_BUNDLE, count, "fill"}) < 0)
        std::fputs("The long History could not be stored.\n", stderr);
    add("start: host with 100000 of History", {TESSEL_PROGRAM, "--profile-dir", profile});
    add("start: the parts, and 100000 values bare", {START_PARTS, profile, MODRIG_BUNDLE, count});
    bench::addRatio({"host start with 100000 of History / parts and bare values",
                     "start: host with 100000 of History", "start: the parts, and 100000 values bare", 1.3});
}
} // namespace

void addStartBenchmarks()
{
    // Standard input is at its end: the host comes to its first prompt and leaves.
    add("start: host to prompt", {TESSEL_PROGRAM, "--profile-dir", profileFolder("host")});
    add("start: the parts, one after the other", {START_PARTS, profileFolder("parts"), MODRIG_BUNDLE});
    bench::addRatio({"host start to prompt / sum of its parts", "start: host to prompt",
                     "start: the parts, one after the other", 1.3});
    addHistoryStart();
}
