// The file-type filters of the file dialogs: what they offer, the remembered choice, and the classic filter
// string.
#pragma once

#include <vector>

#include "modrig/base/CStdStr.h"

namespace ModrigUtils
{
// The keys of the filters that the file panels offer, in their order: all applications, then kind by kind.
// Each has a description under the key, and extensions under the key followed by "_EXT".
[[nodiscard]] std::vector<const char*> FileFilterKeys();

// The description of the filter last chosen, or an empty text.
[[nodiscard]] CStdStr GetRegFileFilterListIndex();

// Remembers the description of the chosen filter. A failure is told in a box, kFilterNotStored.
[[nodiscard]] bool SetRegFileFilterListIndex(const CStdStr& filter);

// Replaces the string with the module's own filters, "description|*.a;*.b|" one after the other, every entry
// followed by a "|", the last one too. The remembered choice comes first. Only extensions of the application
// types table remain. An entry left without any keeps its place and its description, so that the place of
// every other entry is the same in any host.
void ReAdjustFilterString(CStdStr& filter);
} // namespace ModrigUtils
