// Where the platform's Objective-C libraries keep what they remember: settings, and lists of what they found.
#pragma once

#include <string>

namespace tessel
{
// The folder of a profile that is meant for it.
inline constexpr const char* kToolkitFolder = "toolkit";

// Before the first of their classes is used: they keep it in that folder, which need not exist. The first
// call of a process counts. Answers the folder where the person's settings for all programs lie; empty where
// that is the platform's own business.
std::string keepToolkitFilesIn(const std::string& folder);
} // namespace tessel
