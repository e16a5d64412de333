// What the toolkit takes for the arguments and the environment of this process.
#pragma once

#include <string>
#include <vector>

namespace tessel
{
// The environment of this process, "NAME=value" each, in which the variable has this value.
std::vector<std::string> environmentWith(const std::string& variable, const std::string& value);
std::vector<std::string> currentEnvironment();

// Tells the toolkit; left alone it looks for itself before its first use, and ends the process over a byte
// that is no UTF-8. Such bytes reach it as the host's characters for them, by which a file is found all the
// same.
void tellToolkitOfProcess(const std::vector<std::string>& environment);
} // namespace tessel
