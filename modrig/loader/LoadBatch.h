// Loading several files in one go: the one way in which every dialog action loads.
#pragma once

#include <functional>
#include <vector>

#include "modrig/base/CStdStr.h"

namespace ModrigUtils
{
struct BatchFile
{
    CStdStr path;
    bool isHostFolder; // the host's own application folder: passed over, it only got into the selection
};

struct LoadBatch
{
    std::vector<BatchFile> files;
    bool saveHistory = false;
    bool loadAll = false; // the flag of the same name of `PerformModrig`

    // Called with the index of a file, right after it: it is loaded now, newly or since before; it was newly
    // loaded, and the tables want a row.
    std::function<void(std::size_t index)> succeeded;
    std::function<void(std::size_t index)> added;

    // Asked between two files, with how many are done; may be empty. True ends the batch there, and nothing
    // is said about it: whoever stopped it knows.
    std::function<bool(std::size_t done)> isStopped;
};

// Loads the files in order. The first that is not loaded ends the batch; the user has then been told about
// that file, and nothing is said about the others. A batch that gets to its end says what it did.
// Answers how many files were newly loaded by a batch that got to its end or was stopped; 0 for one that
// failed.
[[nodiscard]] unsigned RunLoadBatch(const LoadBatch& batch);
} // namespace ModrigUtils
