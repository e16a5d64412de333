// The dialog's tables by names that fit into a line of a test.
#pragma once

#include "modrig/dialogs/model/TableActions.h"

inline constexpr ModrigUtils::TableKind kLoadedTable = ModrigUtils::TableKind::kLoadedApplications;
inline constexpr ModrigUtils::TableKind kHistoryTable = ModrigUtils::TableKind::kHistory;
