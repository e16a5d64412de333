#include "modrig/dialogs/model/ChosenFiles.h"

#include <algorithm>

namespace ModrigUtils
{
bool PanelSelectionCountsAfterFileType(bool panelIsEmpty, bool chosenInHistory)
{
    return !panelIsEmpty || !chosenInHistory;
}

bool AreChosenInHistory(const std::vector<RowIdentity>& chosen, const std::vector<RowIdentity>& selected)
{
    return !chosen.empty() && std::find(selected.begin(), selected.end(), chosen.back()) != selected.end();
}

bool IsHostFolderOnly(const std::vector<BatchFile>& chosen)
{
    return chosen.size() == 1 && chosen.front().isHostFolder;
}

LoadSource SourceWithoutChoice(bool panelHasSelection, bool historyHasSelection)
{
    if (panelHasSelection)
        return LoadSource::kPanel;
    return historyHasSelection ? LoadSource::kHistory : LoadSource::kNothing;
}
} // namespace ModrigUtils
