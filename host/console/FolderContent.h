// What stands in a folder, for the Tab key.
#pragma once

#include <string>
#include <vector>

#include "host/console/Completion.h"

namespace tessel
{
// Sorted; folders go on. Empty is where the person is. What cannot be typed at a terminal is left out.
std::vector<Branch> contentOfFolder(const std::wstring& folder);
} // namespace tessel
