#include "modrig/loader/LoadedApplications.h"

#include <tessel/tsdocument.h>
#include <tessel/tsed.h>

#include <memory>

#include "modrig/base/CaseFolding.h"
#include "modrig/base/SplitPath.h"
#include "modrig/lists/Globals.h"
#include "modrig/lists/ListMembership.h"
#include "modrig/loader/ApplicationLoader.h"
#include "modrig/loader/HostLinker.h"
#include "modrig/messages/MessageIds.h"
#include "modrig/messages/Messages.h"
#include "modrig/types/ApplicationTypes.h"

namespace ModrigUtils
{
namespace
{
constexpr std::size_t kModulePathSize = 1024;

struct ReleaseResultBuffer
{
    void operator()(TsResultBuffer* list) const { tsutRelRb(list); }
};
using ResultBufferList = std::unique_ptr<TsResultBuffer, ReleaseResultBuffer>;

bool IsNamed(const TsResultBuffer& entry, const CStdStr& name)
{
    return entry.type == TS_STRING && EqualIgnoringCase(entry.value.string, name.Text());
}

bool RefuseFileWithoutDot(const CStdStr& path)
{
    if (path.HasDot())
        return false;
    ModrigAfxMessageBox(ModrigMessages::kCannotLoadFile, path);
    return true;
}

void AddUnlessFound(const CStdStr& path)
{
    if (!FoundinLoadedList(path))
        gLoadedAppList.AddTail(path);
}

// What the host cannot report, macro projects, is all that outlives a rebuild.
void KeepMacroProjectsOnly()
{
    std::vector<CStdStr> reportedByHost;
    for (const CStdStr& path : gLoadedAppList)
        if (FileTypeOfPath(path) != kMacroProject)
            reportedByHost.push_back(path);
    for (const CStdStr& path : reportedByHost)
        RemoveInSpecificList(path, gLoadedAppList);
}

void AddModule(const TsResultBuffer& entry)
{
    wchar_t path[kModulePathSize] = {};
    if (tsedGetModuleFileName(entry.value.string, path, kModulePathSize) != 0)
        return;
    const CStdStr ownName = SplitPath(CStdStr(tsedGetAppName())).FileName();
    if (!IsNamed(entry, ownName))
        AddUnlessFound(CStdStr(std::wstring(path)));
}

// False when the host reports no module at all.
bool AddModules()
{
    const ResultBufferList modules(tsedQmbLoaded());
    for (const TsResultBuffer* entry = modules.get(); entry; entry = entry->next)
        if (entry->type == TS_STRING)
            AddModule(*entry);
    return modules != nullptr;
}

void AddDocumentApplications()
{
    const TsApDocument* document = curDoc();
    const int count = document ? document->loadedApplicationCount() : 0;
    for (int index = 0; index < count; ++index)
        AddUnlessFound(CStdStr(document->loadedApplicationName(index)));
}

void AppendLoadedOf(const CStringList& list, std::vector<CStdStr>& loaded)
{
    for (const CStdStr& path : list)
        if (ApplicationIsLoaded(path))
            loaded.push_back(path);
}
} // namespace

void PopulateLoadedApps()
{
    KeepMacroProjectsOnly();
    // A host that reports no module at all is taken to have nothing to report: the document is not asked
    // either.
    if (AddModules())
        AddDocumentApplications();
}

std::vector<CStdStr> ApplicationsShownAsLoaded()
{
    std::vector<CStdStr> loaded;
    AppendLoadedOf(gLoadedAppList, loaded);
    AppendLoadedOf(gStartupList, loaded);
    return loaded;
}

bool ApplicationIsLoaded(CStdStr path)
{
    if (RefuseFileWithoutDot(path))
        return false;
    // Only compiled modules can be found not loaded: the host does not know what became of the others.
    if (FileTypeOfPath(path) != kCompiledModule)
        return true;
    const CStdStr name = SplitPath(path).FileName();
    const ResultBufferList modules(tsedQmbLoaded());
    for (const TsResultBuffer* entry = modules.get(); entry; entry = entry->next)
        if (IsNamed(*entry, name))
            return true;
    return false;
}

bool IsAppUnloadAble(const CStdStr& path)
{
    return RefuseFileWithoutDot(path) || CouldBeUnloaded(path);
}

bool CouldBeUnloaded(const CStdStr& path)
{
    // True, where `ApplicationIsLoaded` answers false: a row that nobody can place must not stay for ever.
    if (!path.HasDot())
        return true;
    return FileTypeOfPath(path) == kCompiledModule && !IsModuleLocked(path);
}

void UnloadApplications(const std::vector<UnloadCandidate>& candidates,
                        const std::function<void(std::size_t index)>& unloaded)
{
    unsigned count = 0;
    // The summary of one names the last application tried, whether or not it was the one unloaded: that is
    // the one whose own message stands right above.
    CStdStr lastTried;
    for (std::size_t index = 0; index < candidates.size(); ++index)
    {
        if (!candidates[index].unloadable)
            continue;
        lastTried = candidates[index].path;
        if (!LoadApplication(lastTried, kUnload, 0))
            continue;
        unloaded(index);
        RemoveInSpecificList(lastTried, gLoadedAppList);
        ++count;
    }
    ModrigCmdlineSummary(ModrigMessages::kOneUnloaded, ModrigMessages::kManyUnloaded, count, lastTried);
}
} // namespace ModrigUtils
