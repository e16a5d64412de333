#include "bench/Counting.h"

#include <linux/perf_event.h>
#include <sys/ioctl.h>
#include <sys/syscall.h>
#include <sys/wait.h>
#include <unistd.h>
#include <valgrind/callgrind.h>

#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <sstream>
#include <vector>

#include "bench/TemporaryFolder.h"
#include "tests/support/ProgramArguments.h"

namespace bench
{
namespace
{
namespace fs = std::filesystem;

// Set for a process that is to count the first work that it measures.
constexpr const char* kCountHere = "MODRIG_BENCH_COUNT_HERE";
constexpr int kNoFile = -1;
constexpr int kNotStarted = 127;

bool& isToCount()
{
    static bool toCount = std::getenv(kCountHere) != nullptr;
    return toCount;
}

int openCounter()
{
    perf_event_attr wanted = {};
    wanted.type = PERF_TYPE_HARDWARE;
    wanted.size = sizeof wanted;
    wanted.config = PERF_COUNT_HW_INSTRUCTIONS;
    wanted.disabled = 1;
    wanted.inherit = 1;
    wanted.exclude_kernel = 1;
    wanted.exclude_hv = 1;
    constexpr int kThisProcess = 0;
    constexpr int kAnyProcessor = -1;
    constexpr int kNoGroup = -1;
    return static_cast<int>(
        syscall(SYS_perf_event_open, &wanted, kThisProcess, kAnyProcessor, kNoGroup, PERF_FLAG_FD_CLOEXEC));
}

std::vector<std::string> ownArguments()
{
    std::ifstream file("/proc/self/cmdline");
    std::vector<std::string> words;
    for (std::string word; std::getline(file, word, '\0');)
        words.push_back(word);
    words.at(0) = fs::read_symlink("/proc/self/exe").string();
    return words;
}

// Every process that Valgrind has followed has left a file.
double sumOfCounts(const fs::path& folder)
{
    double sum = 0;
    for (const auto& entry : fs::directory_iterator(folder))
    {
        std::ifstream file(entry.path());
        const std::string totals = "totals: ";
        for (std::string line; std::getline(file, line);)
            if (line.starts_with(totals))
                sum += std::stod(line.substr(totals.size()));
    }
    return sum;
}

[[noreturn]] void becomeValgrind(std::vector<std::string> words, const std::string& benchmark,
                                 const std::string& log)
{
    setenv("MODRIG_BENCH_COUNT", benchmark.c_str(), 1);
    if (std::freopen(log.c_str(), "w", stdout))
        dup2(STDOUT_FILENO, STDERR_FILENO);
    execvp(words[0].c_str(), pointersTo(words).data());
    std::fprintf(stderr, "%s: %s\n", words[0].c_str(), std::strerror(errno));
    _exit(kNotStarted);
}

// Answers whether the program ended well.
bool runUnderValgrind(const std::string& benchmark, const fs::path& folder, const std::string& log)
{
    std::vector<std::string> words = {"valgrind", "--tool=callgrind", "--instr-atstart=no",
                                      "--trace-children=yes",
                                      "--callgrind-out-file=" + (folder / "%p").string()};
    for (const std::string& word : ownArguments())
        words.push_back(word);
    const pid_t child = fork();
    if (child == 0)
        becomeValgrind(words, benchmark, log);
    int ended = 1;
    return child > 0 && waitpid(child, &ended, 0) == child && ended == 0;
}

std::string textOf(const std::string& path)
{
    std::ifstream file(path);
    return {std::istreambuf_iterator<char>(file), {}};
}
} // namespace

const std::string& whyNothingCounts()
{
    static const std::string why = []
    {
        const int file = openCounter();
        const std::string reason = file < 0 ? std::strerror(errno) : "";
        if (file >= 0)
            close(file);
        return reason;
    }();
    return why;
}

InstructionCounter::InstructionCounter()
    : mFile(whyNothingCounts().empty() ? openCounter() : kNoFile), mByValgrind(isToCount())
{
    isToCount() = false;
    if (mFile >= 0)
        ioctl(mFile, PERF_EVENT_IOC_ENABLE, 0);
    if (mByValgrind)
        CALLGRIND_START_INSTRUMENTATION;
}

InstructionCounter::~InstructionCounter()
{
    if (mFile >= 0)
        close(mFile);
}

std::optional<double> InstructionCounter::stop()
{
    if (mByValgrind)
        CALLGRIND_STOP_INSTRUMENTATION;
    if (mFile < 0)
        return std::nullopt;
    ioctl(mFile, PERF_EVENT_IOC_DISABLE, 0);
    std::uint64_t count = 0;
    if (read(mFile, &count, sizeof count) != sizeof count)
        return std::nullopt;
    return static_cast<double>(count);
}

std::optional<double> countByValgrind(const std::string& benchmark)
{
    const TemporaryFolder counts("modrig-bench-count");
    const TemporaryFolder words("modrig-bench-count");
    const std::string log = words.path() / "log";
    const bool endedWell = runUnderValgrind(benchmark, counts.path(), log);
    const double count = sumOfCounts(counts.path());
    if (endedWell && count > 0)
        return count;
    std::printf("The instructions of \"%s\" could not be counted. What Valgrind and the program said:\n%s\n",
                benchmark.c_str(), textOf(log).c_str());
    return std::nullopt;
}

void countNextWork()
{
    isToCount() = true;
}

CountElsewhere::CountElsewhere()
{
    if (isToCount())
        setenv(kCountHere, "1", 1);
}

CountElsewhere::~CountElsewhere()
{
    unsetenv(kCountHere);
    isToCount() = false;
}
} // namespace bench
