#include "modrig/lists/FileIntake.h"

#include <wincompat/winfile.h>

#include "modrig/lists/Globals.h"
#include "modrig/lists/ListMembership.h"
#include "modrig/messages/MessageIds.h"
#include "modrig/messages/Messages.h"
#include "modrig/types/FileValidation.h"

namespace ModrigUtils
{
bool RefuseTooManyFiles(std::size_t count)
{
    if (count <= kMaxFilesAtOnce)
        return false;
    CStdStr limit;
    limit.Fmt(L"%d", kMaxFilesAtOnce);
    ModrigAfxMessageBox(ModrigMessages::kTooManyFiles, limit);
    return true;
}

std::vector<CStdStr> AcceptedFiles(const std::vector<CStdStr>& paths)
{
    std::vector<CStdStr> accepted;
    if (RefuseTooManyFiles(paths.size()))
        return accepted;
    for (CStdStr path : paths)
        if (IsValidFileForModrig(path) && ValidateFileExists(path) != INVALID_FILE_ATTRIBUTES)
            accepted.push_back(path);
    return accepted;
}

std::vector<CStdStr> FilesNewToStartupSuite(const std::vector<CStdStr>& paths)
{
    std::vector<CStdStr> accepted = AcceptedFiles(paths);
    std::erase_if(accepted, [](const CStdStr& path) { return FoundinStartupList(path); });
    return accepted;
}

bool RefuseTemporaryInternetFile(const CStdStr& path)
{
    if (!IsTempInternetFile(path))
        return false;
    ModrigAfxMessageBox(ModrigMessages::kTemporaryInternetFile, path);
    return true;
}

void AddToStartupSuite(const std::vector<CStdStr>& paths)
{
    unsigned count = 0;
    CStdStr lastPath;
    for (const CStdStr& path : paths)
    {
        if (RefuseTemporaryInternetFile(path))
            continue;
        if (!FoundinStartupList(path))
            gStartupList.AddTail(path);
        ++count;
        lastPath = path;
    }
    ModrigCmdlineSummary(ModrigMessages::kOneAddedToStartupSuite, ModrigMessages::kManyAddedToStartupSuite,
                         count, lastPath);
}

std::size_t AddToShownStartupSuite(const std::vector<CStdStr>& paths, const StartupSuiteTable& table)
{
    std::size_t count = 0;
    for (std::size_t index = 0; index < paths.size(); ++index)
    {
        if (table.hasRow(index) || RefuseTemporaryInternetFile(paths[index]))
            continue;
        table.addRow(index);
        gStartupList.AddTail(paths[index]);
        ++count;
    }
    return count;
}
} // namespace ModrigUtils
