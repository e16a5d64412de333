// Taking entries out of the lists that the dialogs show.
#pragma once

#include <vector>

#include "modrig/base/CStdStr.h"

namespace ModrigUtils
{
// Takes the files out of the History, and says how many there were.
void RemoveFromHistory(const std::vector<CStdStr>& paths);

// Takes the files out of the Startup Suite, silently: the user sees them go.
void RemoveFromStartupSuite(const std::vector<CStdStr>& paths);
} // namespace ModrigUtils
