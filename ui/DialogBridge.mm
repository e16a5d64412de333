#import <Foundation/Foundation.h>

#include <tessel/tsformat.h>

#include "loader/LoadedApplications.h"
#include "module/DialogBridge.h"
#include "module/Globals.h"

namespace ModrigUtils
{
void SetDialogMessage(const CStdStr&) {}

void RunModrigDialog()
{
    PopulateLoadedApps();
    tsutPrintf(L"%d applications loaded.\n", gLoadedAppList.GetCount());
    for (const CStdStr& path : gLoadedAppList)
        tsutPrintf(L"  %s\n", path.c_str());
}
} // namespace ModrigUtils
