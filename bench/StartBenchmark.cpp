// From the start of the host's process to its first prompt, against what it cannot do without, done by the
// calls of the store and of the system in a bare process. Every run is a new process.
#include <benchmark/benchmark.h>
#include <fcntl.h>
#include <spawn.h>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cstdio>
#include <filesystem>
#include <fstream>
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

// How long the stored lists are that a start reads.
struct Lists
{
    std::size_t suite;
    std::size_t history;
};

std::filesystem::path profileFolder(const Lists& lists)
{
    return bench::workFolder() /
           ("start-" + std::to_string(lists.suite) + "-" + std::to_string(lists.history));
}

std::string entryOfHistory(std::size_t number)
{
    return "/home/user/Applications/library" + std::to_string(number / 100) + "/tool" +
           std::to_string(number) + ".lsp";
}

template <class Entry>
void writeList(std::ostream& file, const std::string& name, std::size_t count, Entry entry)
{
    file << "[HKEY_CURRENT_USER\\Software\\Tessel\\R21\\Profiles\\Default\\Dialogs\\Modrig\\" << name << "]\n"
         << "\"Num" << name << "\"=\"" << count << "\"\n";
    for (std::size_t number = 1; number <= count; ++number)
        file << '"' << number << name << "\"=\"" << entry(number) << "\"\n";
}

// A profile with these lists, as it is after the start that has noted that there is something to load.
bool makeProfile(const Lists& lists)
{
    const auto profile = profileFolder(lists).string();
    const auto source = profile + ".reg";
    const auto modules = bench::folderOfModules("suite", lists.suite);
    std::ofstream file(source);
    file << "Windows Registry Editor Version 5.00\n\n";
    writeList(file, "Startup", lists.suite,
              [&](std::size_t number) { return bench::moduleIn(modules, number - 1).string(); });
    writeList(file, "History", lists.history, entryOfHistory);
    file.close();
    return file &&
           runProgram({TESSEL_PROGRAM, "--profile-dir", profile, "-c", "REGISTRY IMPORT " + source}) >= 0 &&
           runProgram({TESSEL_PROGRAM, "--profile-dir", profile}) >= 0;
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
        ->Repetitions(bench::repetitions(kStartRepetitions));
}

void addBare(const std::string& name, const Lists& lists, const std::string& bundleOrProgram)
{
    add(name, {START_PARTS, (profileFolder(lists) / "registry.db").string(), bundleOrProgram,
               std::to_string(lists.suite), std::to_string(lists.history)});
}

// To a bare start whose bundle the platform loads, and to one that only maps its program. What was measured
// and a tenth.
struct Limits
{
    double loaded;
    double mapped;
};

// Standard input is at its end: the host comes to its first prompt and leaves.
void addStart(const std::string& name, const Lists& lists, const Limits& limits, const std::string& how)
{
    if (!makeProfile(lists))
        std::fputs("The lists of a profile could not be stored.\n", stderr);
    const std::string host = "start: host, " + name;
    const std::string bare = "start: bare, " + name;
    const std::string mapped = bare + ", bundle by dlopen";
    add(host, {TESSEL_PROGRAM, "--profile-dir", profileFolder(lists).string()});
    addBare(bare, lists, MODRIG_BUNDLE);
    addBare(mapped, lists, MODRIG_PROGRAM);
    const std::string ratio = "start to prompt / the same bare, ";
    bench::addRatio(
        {.what = ratio + name, .measured = host, .base = bare, .most = limits.loaded, .how = how});
    bench::addRatio({.what = ratio + "bundle by dlopen, " + name,
                     .measured = host,
                     .base = mapped,
                     .most = limits.mapped});
}
} // namespace

void addStartBenchmarks()
{
    addStart(
        "empty lists", {0, 0}, {.loaded = 1.2, .mapped = 1.4},
        "Bare is a process without any code of the host's own: the registry's file opened with the host's "
        "settings, the bundle loaded by the platform's call for bundles with all libraries that it needs, "
        "its entry point called with a message that does nothing. The platform's call begins the toolkit "
        "(its "
        "character sets, its languages), which mapping the bundle's program by the linker does not; but "
        "classes so mapped do not find their windows and texts. The ratio to that stands beside it.");
    addStart(
        "Suite of 500, History of 10000", {500, 10'000}, {.loaded = 1.25, .mapped = 1.4},
        "Bare also reads the rows of both lists by one prepared statement in one transaction, and maps "
        "and calls each module. Beyond the start itself the host looks at each file before it is mapped, "
        "and at every third start through the whole registry for damage.");
    addStart("History of 100000", {0, 100'000}, {.loaded = 1.1, .mapped = 1.15}, "");
}
