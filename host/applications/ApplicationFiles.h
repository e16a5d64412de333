// Which files are applications, by what they are called.
#pragma once

#include <filesystem>

#include "host/text/Result.h"

namespace tessel
{
// A compiled module, or Lisp.
bool isCalledAsModule(const std::filesystem::path& path);
bool isCalledAsLisp(const std::filesystem::path& path);

// Fails for what is called as an application of a kind that is known and never loaded. Why not is the end of
// a sentence.
Result<> checkKindIsLoaded(const std::filesystem::path& path);

// Whether an application stands at the full path: a file, or a bundle, which is a folder. A file that is
// called as neither is looked into. Why not is a sentence.
Result<> checkIsApplication(const std::filesystem::path& path);
} // namespace tessel
