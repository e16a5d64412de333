#include "modrig/lists/Globals.h"

#include "modrig/types/ApplicationTypes.h"

// One file, so that the order of construction is the order of these lines: the table first, then the lists as
// loaded, startup, history; they are destroyed in reverse.
CExtInfo sExtInfo[kApplicationTypes] = {
    {L"bundle", kCompiledModule}, {L"zmb", kCompiledModule}, {L"lsp", kLispFile}, {L"mcp", kMacroProject},
    {L"omp", kCompiledModule},    {L"rpk", kPackagedLisp},   {L"qbc", kLispFile},
};

CStringList gLoadedAppList;
CStringList gStartupList;
CStringList gHistoryList;

bool gbOrreryLoaded = false;
HMODULE hModrigRes = nullptr;
const wchar_t* const kpszCmdModule = L" Command Module";
