// Bundle folders, loaded by the platform, so that the classes in them find their resources.
#pragma once

#include <string>
#include <string_view>

#include "host/text/Result.h"

namespace tessel
{
// Whether the path names a bundle: it ends in ".bundle", in any case of letters.
bool isBundlePath(std::string_view path);

// Why one of the functions below fails is the end of a sentence, with one of these codes where it matters.
// None of them lets an Objective-C exception pass.
enum BundleFailure
{
    kBundleNotAccepted = 2, // the platform keeps the reason to itself
    kBundleRaised = 3       // an exception: the sentence is what that says of itself
};

// The file with the bundle's code, which is there and lies in the bundle.
Result<std::string> programOfBundle(const std::string& folder);

// Maps the bundle's code and makes its classes known. A bundle that is loaded already stays so. Exceptions
// of C++ that the code throws pass through.
Result<> loadBundle(const std::string& folder);

// Takes the code out again, as far as the platform can.
Result<> unloadBundle(const std::string& folder);
} // namespace tessel
