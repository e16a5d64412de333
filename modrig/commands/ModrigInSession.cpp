#include "modrig/commands/ModrigInSession.h"

#include <tessel/tsappinfo.h>
#include <tessel/tsed.h>
#include <tessel/tsrxlinker.h>
#include <tessel/tssession.h>

#include "modrig/commands/CommandTexts.h"
#include "modrig/profile/ModrigRecord.h"

namespace ModrigUtils
{
namespace
{
constexpr const wchar_t* kModule = L"Modrig.bundle";
constexpr std::size_t kLongestNameOfModule = 1024;
constexpr bool kQuietly = false;
constexpr bool kTellWhyNot = true;
constexpr bool kResolveAllNow = true;

CStdStr PathOfModrig()
{
    wchar_t path[kLongestNameOfModule] = {};
    return tsedGetModuleFileName(kModule, path, kLongestNameOfModule) == 0 ? CStdStr(std::wstring(path))
                                                                           : CStdStr();
}

bool IsLoadedByItsCommand()
{
    TesselAppInfo record;
    record.setAppName(kRecordName);
    return record.readFromRegistry() == TSRX_APPINFO_OK && (record.loadReason() & TSRX_LOAD_ON_COMMAND) != 0;
}

TsRxDynamicLinker* Linker()
{
    return TsRxDynamicLinker::cast(tsrxSysRegistry()->at(TSRX_DYNAMIC_LINKER));
}
} // namespace

ModrigOutOfService::ModrigOutOfService() : mPath(PathOfModrig())
{
    if (mPath.IsEmpty())
        return;
    mSucceeded = Linker() && Linker()->unloadModule(mPath.c_str(), kQuietly);
    mWaits = mSucceeded && IsLoadedByItsCommand();
}

ModrigOutOfService::~ModrigOutOfService()
{
    if (!mPath.IsEmpty() && mSucceeded && !mWaits)
        Linker()->loadModule(mPath.c_str(), kTellWhyNot, kResolveAllNow);
}

CStdStr WhyNobodyCanChange(const KeptList& list)
{
    const CStdStr name = CStdStr::OfId(list.nameText);
    if (const CStdStr place = LaidDownInstead(list); !place.IsEmpty())
        return CStdStr::Formatted(ModrigMessages::kLaidDown, name.c_str(), place.c_str());
    if (tsrxOtherSessionRuns())
        return CStdStr::Formatted(ModrigMessages::kOtherSessionRuns, name.c_str());
    return {};
}

// Without a record Modrig is loaded at each start, and makes one when there is something to load.
void UpdateRecordOfModrig(bool hasStartup)
{
    TesselAppInfo record;
    record.setAppName(kRecordName);
    if (record.readFromRegistry() != TSRX_APPINFO_OK)
        return;
    if (SetLoadedAtStart(record, hasStartup))
        record.writeToRegistry(false, false); // the commands in it are Modrig's
}
} // namespace ModrigUtils
