// SUITE and HISTORY: the module's lists on the command line, by the module's own rules.
#pragma once

#include <tessel/tsresbuf.h>

namespace ModrigUtils
{
// The handlers of the commands.
void RunSuite();
void RunHistory();

// What stands in the lists, for the Tab key; the host frees it.
TsResultBuffer* SuiteEntries();
TsResultBuffer* HistoryEntries();
} // namespace ModrigUtils
