#include "modrig/lists/ListRemoval.h"

#include "modrig/lists/Globals.h"
#include "modrig/lists/ListMembership.h"
#include "modrig/messages/MessageIds.h"
#include "modrig/messages/Messages.h"

namespace ModrigUtils
{
namespace
{
void RemoveAllOf(const std::vector<CStdStr>& paths, CStringList& list)
{
    for (const CStdStr& path : paths)
        RemoveInSpecificList(path, list);
}
} // namespace

void RemoveFromHistory(const std::vector<CStdStr>& paths)
{
    RemoveAllOf(paths, gHistoryList);
    if (!paths.empty())
        ModrigCmdlineSummary(ModrigMessages::kOneRemovedFromHistory, ModrigMessages::kManyRemovedFromHistory,
                             static_cast<unsigned>(paths.size()), paths.back());
}

void RemoveFromStartupSuite(const std::vector<CStdStr>& paths)
{
    RemoveAllOf(paths, gStartupList);
}
} // namespace ModrigUtils
