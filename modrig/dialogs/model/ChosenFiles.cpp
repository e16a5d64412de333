#include "modrig/dialogs/model/ChosenFiles.h"

namespace ModrigUtils
{
bool PanelSelectionCounts(PanelChange change, bool panelIsEmpty, bool chosenInHistory)
{
    return change == PanelChange::kChoice || !panelIsEmpty || !chosenInHistory;
}

LoadSource SourceWithoutChoice(bool panelHasSelection, bool historyHasSelection)
{
    if (panelHasSelection)
        return LoadSource::kPanel;
    return historyHasSelection ? LoadSource::kHistory : LoadSource::kNothing;
}
} // namespace ModrigUtils
