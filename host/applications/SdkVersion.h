// The version of the SDK that a compiled application was built with, as far as it says so
// (tessel/tsversion.h). It is read from the file: a module that calls what this host has not could not be
// mapped, and the system's linker would name a function and not the reason.
#pragma once

#include <compare>
#include <cstdint>
#include <optional>

#include "host/platform/ImageCheck.h"
#include "host/text/Result.h"

namespace tessel
{
struct SdkVersion
{
    std::uint32_t majorNumber = 0;
    std::uint32_t minorNumber = 0;

    // clang-tidy 14 takes the comparison with 0 inside for a null pointer.
    auto operator<=>(const SdkVersion&) const = default; // NOLINT(modernize-use-nullptr)
};

// What a file says that may be mapped (`checkMappable`); nothing when it does not say.
std::optional<SdkVersion> sdkVersionIn(std::uint64_t fileSize, const ReadAt& readAt);

// Whether an application of that version finds here what it needs; why not is the end of a sentence.
Result<> checkSdkVersion(const std::optional<SdkVersion>& wanted);
} // namespace tessel
