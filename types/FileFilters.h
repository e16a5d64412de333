// The file-type filters of the file dialogs: the remembered choice, and the classic filter string.
#pragma once

#include "module/CStdStr.h"

namespace ModrigUtils
{
// The description of the filter last chosen, or an empty text.
CStdStr GetRegFileFilterListIndex();

// Remembers the description of the chosen filter. A failure is told in message box 24.
bool SetRegFileFilterListIndex(const CStdStr& filter);

// Replaces the string with the module's own filters, "description|*.a;*.b|" one behind the other, every entry
// followed by a "|", the last one too. The remembered choice comes first; only extensions of the application
// types table remain, and an entry left without any is dropped, since an empty pattern list would end the
// string for whoever reads it.
void ReAdjustFilterString(CStdStr& filter);
} // namespace ModrigUtils
