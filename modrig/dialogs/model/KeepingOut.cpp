#include "modrig/dialogs/model/KeepingOut.h"

#include <algorithm>

#include "modrig/loader/KeptOut.h"

namespace ModrigUtils
{
namespace
{
bool IsKeptOut(const CStdStr& path)
{
    return !WhyKeptOut(path).IsEmpty();
}
} // namespace

TableAction KeepingOutActionFor(const std::vector<CStdStr>& paths)
{
    if (!HostKeepsApplicationsOut())
        return TableAction::kNone;
    return std::any_of(paths.begin(), paths.end(), IsKeptOut) ? TableAction::kLetIn : TableAction::kKeepOut;
}

void KeepAllOut(const std::vector<CStdStr>& paths)
{
    for (const CStdStr& path : paths)
        KeepOut(path);
}

void LetAllIn(const std::vector<CStdStr>& paths)
{
    for (const CStdStr& path : paths)
        if (IsKeptOut(path))
            LetIn(path);
}
} // namespace ModrigUtils
