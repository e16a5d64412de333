// Counting the processor's instructions: by the processor itself where the system lets it, or by Valgrind,
// which runs a program much slower and so counts one benchmark in a run of its own.
#pragma once

#include <cstdint>
#include <optional>
#include <string>

namespace bench
{
// Why the machine counts no instructions; empty when it does.
const std::string& whyNothingCounts();

// Counts from its making on, what this process and all that it starts meanwhile does outside of the system.
class InstructionCounter
{
public:
    InstructionCounter();
    ~InstructionCounter();
    InstructionCounter(const InstructionCounter&) = delete;
    InstructionCounter& operator=(const InstructionCounter&) = delete;

    // Nothing where the machine does not count, and while Valgrind does: that tells it at the program's end.
    std::optional<double> stop();

private:
    int mFile;
    bool mByValgrind;
};

// Has this program run once more, with the same arguments, under Valgrind, for this benchmark alone, and
// answers the instructions of the first work that it measures. Says why when that fails.
std::optional<double> countByValgrind(const std::string& benchmark);

// The first work that is measured from now on is what Valgrind counts.
void countNextWork();

// While it lives, that work is looked for in processes that this one starts, and not after that in this one.
class CountElsewhere
{
public:
    CountElsewhere();
    ~CountElsewhere();
    CountElsewhere(const CountElsewhere&) = delete;
    CountElsewhere& operator=(const CountElsewhere&) = delete;
};
} // namespace bench
