// Taking entries out of the lists that the dialogs show.
#pragma once

#include <functional>
#include <vector>

#include "modrig/base/CStdStr.h"

namespace ModrigUtils
{
// Called with the index of a path right before it leaves its list: the table's row goes first, so that table
// and list are in step after each.
using Removing = std::function<void(std::size_t index)>;

// Takes the files out of the History, one by one, and says how many there were.
void RemoveFromHistory(const std::vector<CStdStr>& paths, const Removing& removing);

// Takes the files out of the Startup Suite, silently: the user sees them go.
void RemoveFromStartupSuite(const std::vector<CStdStr>& paths, const Removing& removing);
} // namespace ModrigUtils
