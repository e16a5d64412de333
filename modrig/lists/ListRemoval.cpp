#include "modrig/lists/ListRemoval.h"

#include "modrig/lists/Globals.h"
#include "modrig/lists/ListMembership.h"
#include "modrig/messages/MessageIds.h"
#include "modrig/messages/Messages.h"

namespace ModrigUtils
{
namespace
{
void RemoveOneByOne(const std::vector<CStdStr>& paths, CStringList& list, const Removing& removing)
{
    for (std::size_t index = 0; index < paths.size(); ++index)
    {
        removing(index);
        RemoveInSpecificList(paths[index], list);
    }
}
} // namespace

void RemoveFromHistory(const std::vector<CStdStr>& paths, const Removing& removing)
{
    RemoveOneByOne(paths, gHistoryList, removing);
    if (!paths.empty())
        ModrigCmdlineSummary(ModrigMessages::kOneRemovedFromHistory, ModrigMessages::kManyRemovedFromHistory,
                             static_cast<unsigned>(paths.size()), paths.back());
}

void RemoveFromStartupSuite(const std::vector<CStdStr>& paths, const Removing& removing)
{
    RemoveOneByOne(paths, gStartupList, removing);
}
} // namespace ModrigUtils
