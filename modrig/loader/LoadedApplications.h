// The list of loaded applications: rebuilt from the host, asked, and unloaded from.
#pragma once

#include <functional>
#include <vector>

#include "modrig/base/CStdStr.h"

namespace ModrigUtils
{
// Rebuilds `gLoadedAppList`: macro projects stay, everything else is what the host reports (compiled modules
// but for this one, then the applications of the current document). In a host without any loaded module the
// list keeps its macro projects only.
void PopulateLoadedApps();

// The applications that the dialog lists as loaded: those of `gLoadedAppList`, then those of the Startup
// Suite, but for what the host has no longer. An application may come twice.
[[nodiscard]] std::vector<CStdStr> ApplicationsShownAsLoaded();

// Whether the host has the compiled module loaded (asked by file name). True for files of every other kind. A
// path without a dot: kCannotLoadFile and false.
[[nodiscard]] bool ApplicationIsLoaded(CStdStr path);

// Whether the compiled module may be unloaded. False for files of every other kind. A path without a dot:
// kCannotLoadFile and true.
[[nodiscard]] bool IsAppUnloadAble(const CStdStr& path);

// The same answer without a word.
[[nodiscard]] bool CouldBeUnloaded(const CStdStr& path);

// An application that the user wants unloaded, and whether it could be unloaded when it was listed.
struct UnloadCandidate
{
    CStdStr path;
    bool unloadable;
};

// Unloads every candidate that is unloadable, in order, takes those unloaded out of `gLoadedAppList` and says
// how many there were. `unloaded` is called with the index of each right before it leaves the list: the
// table's row goes first, so that table and list are in step before the next is tried.
void UnloadApplications(const std::vector<UnloadCandidate>& candidates,
                        const std::function<void(std::size_t index)>& unloaded);
} // namespace ModrigUtils
