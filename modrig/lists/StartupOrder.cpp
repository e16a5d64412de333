#include "modrig/lists/StartupOrder.h"

#include <algorithm>
#include <vector>

#include "modrig/lists/Globals.h"

namespace ModrigUtils
{
bool MoveInStartupSuite(const CStdStr& path, const CStdStr& neighbour)
{
    std::vector<CStdStr> entries(gStartupList.begin(), gStartupList.end());
    const auto find = [&entries](const CStdStr& text)
    {
        return std::find_if(entries.begin(), entries.end(),
                            [&text](const CStdStr& entry) { return entry.EqualsNoCase(text); });
    };
    const auto from = find(path);
    const auto to = find(neighbour);
    if (from == entries.end() || to == entries.end())
        return false;
    if (from < to)
        std::rotate(from, from + 1, to + 1);
    else
        std::rotate(to, from, from + 1);
    gStartupList.RemoveAll();
    for (const CStdStr& entry : entries)
        gStartupList.AddTail(entry);
    return true;
}
} // namespace ModrigUtils
