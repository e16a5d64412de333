// Bundle folders, loaded by the platform, so that the classes in them find their resources.
#pragma once

#include <string>
#include <string_view>

#include "host/text/Result.h"

namespace tessel
{
// Whether the path names a bundle: it ends in ".bundle", in any case of letters.
bool isBundlePath(std::string_view path);

// The file with the bundle's code; why there is none is the end of a sentence.
Result<std::string> programOfBundle(const std::string& folder);

// Maps the bundle's code and makes its classes known. A bundle that is loaded already stays so. False when
// the platform refuses.
bool loadBundle(const std::string& folder);

// Takes the code out again, as far as the platform can.
void unloadBundle(const std::string& folder);
} // namespace tessel
