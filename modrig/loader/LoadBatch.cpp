#include "modrig/loader/LoadBatch.h"

#include "modrig/loader/ApplicationLoader.h"
#include "modrig/messages/MessageIds.h"
#include "modrig/messages/Messages.h"

namespace ModrigUtils
{
namespace
{
struct Progress
{
    unsigned processed = 0;
    unsigned added = 0;
    bool someAlreadyLoaded = false;
    CStdStr lastPath;
};

bool LoadFile(const LoadBatch& batch, std::size_t index, Progress& progress)
{
    const CStdStr& path = batch.files[index].path;
    const int result = PerformModrig(path, batch.saveHistory ? kAddToHistory : kDoNotAddToHistory,
                                     batch.loadAll ? kLoadAll : 0, kReportFailure);
    if (result != kLoaded && result != kAlreadyLoaded)
        return false;
    batch.succeeded(index);
    if (result == kLoaded)
    {
        batch.added(index);
        ++progress.added;
    }
    else
        progress.someAlreadyLoaded = true;
    ++progress.processed;
    progress.lastPath = path;
    return true;
}

bool IsStopped(const LoadBatch& batch, const Progress& progress)
{
    return progress.processed > 0 && batch.isStopped && batch.isStopped(progress.processed);
}

void SaySummary(const Progress& progress)
{
    const unsigned one =
        progress.someAlreadyLoaded ? ModrigMessages::kAlreadyLoaded : ModrigMessages::kOneLoaded;
    ModrigCmdlineSummary(one, ModrigMessages::kManyLoaded, progress.processed, progress.lastPath);
}
} // namespace

unsigned RunLoadBatch(const LoadBatch& batch)
{
    Progress progress;
    if (batch.files.empty())
        return 0;
    for (std::size_t index = 0; index < batch.files.size(); ++index)
    {
        if (batch.files[index].isHostFolder)
            continue;
        if (IsStopped(batch, progress))
            return progress.added;
        // What follows may depend on the file that failed: nothing more is tried.
        if (!LoadFile(batch, index, progress))
            return 0;
    }
    SaySummary(progress);
    return progress.added;
}
} // namespace ModrigUtils
