#include "ui/model/ListRemoval.h"

#include "lists/ListMembership.h"
#include "module/Globals.h"
#include "module/MessageIds.h"
#include "module/Messages.h"

namespace ModrigUtils
{
void RemoveFromHistory(const std::vector<CStdStr>& paths)
{
    for (const CStdStr& path : paths)
        RemoveInSpecificList(path, gHistoryList);
    if (!paths.empty())
        ModrigCmdlineSummary(ModrigMessages::kOneRemovedFromHistory, ModrigMessages::kManyRemovedFromHistory,
                             static_cast<unsigned>(paths.size()), paths.back());
}

void RemoveFromStartupSuite(const std::vector<CStdStr>& paths)
{
    for (const CStdStr& path : paths)
        RemoveInSpecificList(path, gStartupList);
}
} // namespace ModrigUtils
