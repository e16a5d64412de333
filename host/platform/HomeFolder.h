// Home folders, as a shell writes them.
#pragma once

#include <string>

namespace tessel
{
// "~" and "~/x" begin with the person's own home folder then, "~ada/x" with that of another. What is no such
// path, and whose home nobody knows, stays as it is.
std::string withHomeFolder(const std::string& typed);
} // namespace tessel
