#include "modrig/loader/ApplicationLoader.h"

#include <tessel/tsed.h>

#include <utility>

#include "modrig/base/SplitPath.h"
#include "modrig/lists/Globals.h"
#include "modrig/lists/ListMembership.h"
#include "modrig/loader/FailedLoads.h"
#include "modrig/loader/HostLinker.h"
#include "modrig/messages/MessageIds.h"
#include "modrig/messages/Messages.h"
#include "modrig/types/ApplicationTypes.h"

namespace ModrigUtils
{
namespace
{
// Only a short 0 switches Lisp off: a host without the variable, or with one of another type, has Lisp.
bool LispIsDisabled()
{
    TsResultBuffer value = {};
    if (tsedGetVar(L"LISPENABLED", &value) != TS_NORMAL)
        return false;
    if (value.type == TS_STRING)
        delete[] value.value.string;
    return value.type == TS_SHORT && value.value.shortNumber == 0;
}

// Macro projects are no Lisp, and stand here all the same: who switches Lisp off wants no scripts loaded.
bool IsRefusedWhileLispIsOff(const CStdStr& path)
{
    const ApplicationKind* kind = KindOfFile(SplitPath(path));
    return kind && (kind->isLisp || kind->type == kMacroProject);
}

void RecordLoaded(const CStdStr& path, bool listedAlready, int addToHistory)
{
    if (!listedAlready)
        gLoadedAppList.AddTail(path);
    if (addToHistory && !FoundinHistoryList(path))
        gHistoryList.AddTail(path);
}

bool RefuseFile(const CStdStr& path)
{
    ModrigAfxMessageBox(ModrigMessages::kCannotLoadFile, path);
    return false;
}
} // namespace

int PerformModrig(CStdStr path, int addToHistory, signed char loadAll, signed char reportFailure)
{
    if (LispIsDisabled() && IsRefusedWhileLispIsOff(path))
        return kNotLoaded;
    const bool alreadyLoaded = FoundinLoadedList(path);
    const bool isLispApp = alreadyLoaded && IsALispAppFoundinList(path);
    if (alreadyLoaded && !isLispApp)
        return kAlreadyLoaded;
    const bool isLoaded = LoadApplication(path, kLoad, loadAll);
    NoteLoad(path, isLoaded);
    if (isLoaded)
    {
        RecordLoaded(path, isLispApp, addToHistory);
        return kLoaded;
    }
    if (reportFailure)
        ModrigAfxMessageBox(ModrigMessages::kLoadFailed, path);
    return kNotLoaded;
}

bool LoadApplication(CStdStr path, signed char load, signed char loadAll)
{
    if (!path.HasDot())
        return RefuseFile(path);
    switch (FileTypeOfPath(path))
    {
    case kCompiledModule:
        return LoadQMBFile(std::move(path), load);
    case kLispFile:
        return LoadLispFile(std::move(path), load, loadAll);
    default:
        // Macro projects and packaged Lisp are known kinds, but there is no road to load them by.
        return RefuseFile(path);
    }
}

bool LoadQMBFile(CStdStr path, signed char load)
{
    if (load)
    {
        TsRxDynamicLinker* linker = HostLinker();
        return linker && linker->loadModule(path.c_str(), kSayWhyNot, kResolveNow);
    }
    if (IsModuleLocked(path))
    {
        ModrigCmdlineMessage(ModrigMessages::kModuleLocked, path);
        return false;
    }
    TsRxDynamicLinker* linker = HostLinker();
    return linker && linker->unloadModule(path.c_str(), kSayWhyNot);
}
} // namespace ModrigUtils
