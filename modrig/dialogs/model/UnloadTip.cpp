#include "modrig/dialogs/model/UnloadTip.h"

#include <algorithm>

namespace ModrigUtils
{
namespace
{
bool Has(const std::vector<RowState>& rows, RowState state)
{
    return std::find(rows.begin(), rows.end(), state) != rows.end();
}
} // namespace

std::vector<const char*> UnloadTip(bool someAreSelected, const std::vector<RowState>& rows)
{
    if (someAreSelected)
        return {"IDS_MODRIG_UNLOAD_SELECTED"};
    if (rows.empty())
        return {"IDS_MODRIG_UNLOAD_NOTHING_LOADED"};
    std::vector<const char*> lines = {Has(rows, RowState::kUsable) ? "IDS_MODRIG_UNLOAD_NOTHING_SELECTED"
                                                                   : "IDS_MODRIG_UNLOAD_NONE"};
    if (Has(rows, RowState::kLocked))
        lines.push_back("IDS_MODRIG_UNLOAD_LOCKED");
    if (Has(rows, RowState::kNeverUnloaded))
        lines.push_back("IDS_MODRIG_UNLOAD_NEVER");
    return lines;
}
} // namespace ModrigUtils
