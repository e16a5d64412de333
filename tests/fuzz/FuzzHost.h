// What the targets share that run on the host's own parts: a folder that goes with the process, and outcomes
// that are worth keeping an input for. The parts are built without telling which of their lines were reached.
#pragma once

#include <cstdint>
#include <cstdlib>
#include <functional>
#include <string>

#include "tests/support/TemporaryFolder.h"

inline void require(bool condition)
{
    if (!condition)
        std::abort();
}

inline constexpr std::size_t kOutcomes = 4096;

// Read by the fuzzer after each input, and set to 0 before the next.
__attribute__((used, section("__libfuzzer_extra_counters"))) inline std::uint8_t gOutcomes[kOutcomes];

// An outcome of the input; those that were not seen before make it one to go on from.
inline void note(const std::wstring& outcome)
{
    gOutcomes[std::hash<std::wstring>()(outcome) % kOutcomes] = 1;
}

inline const TemporaryFolder& fuzzFolder()
{
    static const TemporaryFolder folder;
    return folder;
}
