// SUITE and HISTORY: the module's lists on the command line, by the module's own rules.
#pragma once

namespace ModrigUtils
{
// The handlers of the commands.
void RunSuite();
void RunHistory();
} // namespace ModrigUtils
