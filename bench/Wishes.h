// What whoever starts the benchmarks wants of them. The environment says it, so that every program of the
// benchmarks, and what these start, learns it in the same way; tools/bench sets it.
#pragma once

#include <string>

namespace bench
{
struct Wishes
{
    // MODRIG_BENCH_QUICK: few repetitions, and no limit is judged.
    bool quick = false;
    // MODRIG_BENCH_ONLY: figures whose names hold this alone, stars as in a shell; all when empty.
    std::string only;
    // MODRIG_BENCH_RESULTS: the file to write the figures to, as JSON; none when empty.
    std::string results;
    // MODRIG_BENCH_COUNT: the one benchmark of which Valgrind counts the instructions.
    std::string count;
};

// Read once.
const Wishes& wishes();
} // namespace bench
