// Bundle folders, loaded by the platform, so that the classes in them find their resources.
#pragma once

#include <string>
#include <string_view>

#include "host/text/Result.h"

namespace tessel
{
// Whether the path names a bundle: it ends in ".bundle", in any case of letters.
bool isBundlePath(std::string_view path);

// The file with the bundle's code, which is there and lies in the bundle. Why there is none is the end of a
// sentence, as with the others; none of them throws an Objective-C exception.
Result<std::string> programOfBundle(const std::string& folder);

// Maps the bundle's code and makes its classes known. A bundle that is loaded already stays so. Exceptions
// of C++ that the code throws pass through.
Result<> loadBundle(const std::string& folder);

// The code of a failure when the platform keeps the reason to itself.
inline constexpr int kBundleNotAccepted = 2;

// Takes the code out again, as far as the platform can.
Result<> unloadBundle(const std::string& folder);
} // namespace tessel
