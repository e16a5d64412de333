// The lists and what else the module's parts share. Main thread only.
//
// They are defined in Globals.cpp together with the application types table (ApplicationTypes.h), because
// they have to be constructed in order: the table, then the three lists. All exist before the host first
// calls the entry point. What needs no order stands where it is used.
#pragma once

#include "modrig/base/CStringList.h"

extern CStringList gLoadedAppList; // applications believed loaded
extern CStringList gStartupList;   // the Startup Suite
extern CStringList gHistoryList;   // files loaded before

// The host's Lisp development environment has been loaded. The module only clears and reads it; other code of
// the process sets it through the exported symbol.
extern "C" TESSEL_EXPORT bool gbOrreryLoaded;

// The resource module, as the last load message found it; stale once it has been released.
extern HMODULE hModrigRes;

// Ends the description of the module in the host's record of applications.
extern const wchar_t* const kpszCmdModule;
