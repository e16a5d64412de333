#include "modrig/lists/Globals.h"

#include "modrig/types/ApplicationTypes.h"

// One file, so that the order of construction is the order of these lines: the table first, then the lists as
// loaded, startup, history; they are destroyed in reverse.
std::array<CExtInfo, kApplicationTypes> sExtInfo = ModrigUtils::UsableKinds();

CStringList gLoadedAppList;
CStringList gStartupList;
CStringList gHistoryList;

bool gbOrreryLoaded = false;
HMODULE hModrigRes = nullptr;
const wchar_t* const kpszCmdModule = L" Command Module";
