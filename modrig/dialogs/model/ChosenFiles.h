// Which files Load will load. They are chosen in two places, the file panel and the History, and what was
// chosen last counts.
#pragma once

#include <vector>

#include "modrig/loader/LoadBatch.h"

namespace ModrigUtils
{
// Whether the panel's selection is what Load will load after another file type took files out of sight. A
// file type is not a choice of files: when it leaves the panel without any, what is chosen in the History
// stays chosen.
[[nodiscard]] bool PanelSelectionCountsAfterFileType(bool panelIsEmpty, bool chosenInHistory);

// A row, told from others that stand for the same file.
using RowIdentity = const void*;

// Whether what Load will load was chosen in the History: its last file is a row that is selected there.
[[nodiscard]] bool AreChosenInHistory(const std::vector<RowIdentity>& chosen,
                                      const std::vector<RowIdentity>& selected);

// Whether Load goes into a folder instead: the host's own application folder is all that is chosen.
[[nodiscard]] bool IsHostFolderOnly(const std::vector<BatchFile>& chosen);

enum class LoadSource
{
    kPanel,
    kHistory,
    kNothing
};

// Where Load takes its files from when the last change left none chosen, as removing rows from the History
// does: what is still selected elsewhere is meant.
[[nodiscard]] LoadSource SourceWithoutChoice(bool panelHasSelection, bool historyHasSelection);
} // namespace ModrigUtils
