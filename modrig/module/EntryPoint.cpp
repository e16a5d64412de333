#include "modrig/module/EntryPoint.h"

#include <tessel/tsappinfo.h>
#include <tessel/tsed.h>
#include <tessel/tsedcommands.h>

#include "modrig/lists/Globals.h"
#include "modrig/lists/History.h"
#include "modrig/loader/HostLinker.h"
#include "modrig/loader/StartupSuite.h"
#include "modrig/messages/MessageIds.h"
#include "modrig/messages/ResourceOverride.h"
#include "modrig/module/DialogBridge.h"
#include "modrig/profile/ModrigRecord.h"

namespace
{
constexpr const wchar_t* kResourceModule = L"ModrigRes.dll";
constexpr long kNoLanguage = 0;
constexpr int kPlainCommand = 0;
constexpr int kNoFunctionCode = -1;
constexpr bool kForCurrentUser = false;
constexpr bool kWithCommands = true;

void RegisterWithLinker(void* application)
{
    if (TsRxDynamicLinker* linker = ModrigUtils::HostLinker())
        linker->registerApplication(application);
}

// Without one of its three names there is no command, and nobody to tell: the text that is missing would be
// the one to say so.
void RegisterCommand()
{
    CStdStr group;
    CStdStr globalName;
    CStdStr localName;
    if (!group.Load(ModrigMessages::kCommandGroup, hModrigRes) ||
        !globalName.Load(ModrigMessages::kCommandGlobalName, hModrigRes) ||
        !localName.Load(ModrigMessages::kCommandLocalName, hModrigRes))
        return;
    TsEdCommandStack* commands = TsEdCommandStack::cast(tsrxSysRegistry()->at(TSED_REGISTERED_COMMANDS));
    if (!commands)
        return;
    // After an unload and a load the command is there already, which is as good as added.
    commands->addCommand(group.c_str(), globalName.c_str(), localName.c_str(), kPlainCommand,
                         ModrigUtils::ModrigCreate, nullptr, kNoFunctionCode, nullptr, nullptr);
}

int Load(void* application)
{
    if (!CTemporaryResourceOverride::SetDefaultResource(kNoLanguage, kResourceModule))
        return TSRX_RET_ERROR;
    hModrigRes = CTemporaryResourceOverride::m_hInstanceDefault;
    RegisterWithLinker(application);
    initApp();
    return TSRX_RET_OK;
}

// A record that cannot be written costs the user a command typed at the next start, and nothing else.
void WriteRecord(TesselAppInfo& record)
{
    record.writeToRegistry(kForCurrentUser, kWithCommands);
}

void CreateRecord(TesselAppInfo& record)
{
    record.setModuleName(tsedGetAppName());
    record.setDescription((CStdStr(ModrigUtils::kRecordName) + CStdStr(kpszCmdModule)).c_str());
    record.setLoadReason(TSRX_LOAD_AT_HOST_START | TSRX_LOAD_ON_COMMAND);
    WriteRecord(record);
}
} // namespace

int tsrxEntryPoint(unsigned message, void* application)
{
    switch (message)
    {
    case TSRX_MSG_LOAD:
        return Load(application);
    case TSRX_MSG_UNLOAD:
        CTemporaryResourceOverride::ReleaseDefaultResource();
        return TSRX_RET_OK;
    default:
        return TSRX_RET_OK;
    }
}

void initApp()
{
    const CTemporaryResourceOverride texts(CTemporaryResourceOverride::m_hInstanceDefault);
    ModrigUtils::InitializeStartupFiles();
    ModrigUtils::InitializeHistoryFiles();
    RegisterCommand();
    ModrigUtils::updateRegistry();
}

void unloadApp()
{
}

namespace ModrigUtils
{
void ModrigCreate()
{
    const CTemporaryResourceOverride texts(CTemporaryResourceOverride::m_hInstanceDefault);
    RunModrigDialog();
}

void updateRegistry()
{
    TesselAppInfo record;
    record.setAppName(kRecordName);
    const bool hasStartup = !gStartupList.IsEmpty();
    if (record.readFromRegistry() != TSRX_APPINFO_OK)
    {
        if (hasStartup)
            CreateRecord(record);
    }
    else if (SetLoadedAtStart(record, hasStartup))
        WriteRecord(record);
}
} // namespace ModrigUtils
