#include "modrig/lists/ListMembership.h"

#include "modrig/base/SplitPath.h"
#include "modrig/lists/Globals.h"
#include "modrig/types/ApplicationTypes.h"

namespace ModrigUtils
{
const CStringList& StartupSuiteFiles()
{
    return gStartupList;
}

const CStringList& HistoryFiles()
{
    return gHistoryList;
}

bool FoundinSpecificList(const CStdStr& path, const CStringList& list)
{
    return list.HoldsApplication(path);
}

bool FoundinStartupList(const CStdStr& path)
{
    return FoundinSpecificList(path, gStartupList);
}

bool FoundinHistoryList(const CStdStr& path)
{
    return FoundinSpecificList(path, gHistoryList);
}

bool FoundinLoadedList(const CStdStr& path)
{
    return FoundinSpecificList(path, gLoadedAppList);
}

bool IsALispAppFoundinList(const CStdStr& path)
{
    const ApplicationKind* kind = KindOfFile(SplitPath(path));
    return kind && kind->isLisp && FoundinSpecificList(path, gLoadedAppList);
}

void RemoveInSpecificList(const CStdStr& path, CStringList& list)
{
    static_cast<void>(list.RemoveFirstNoCase(path)); // not there is as good as removed
}
} // namespace ModrigUtils
