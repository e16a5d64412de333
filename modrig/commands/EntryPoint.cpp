// What the host calls of the application that brings the commands.
#include <tessel/tsedcommands.h>

#include "modrig/commands/CommandTexts.h"
#include "modrig/commands/ListCommands.h"
#include "modrig/messages/MessageLine.h"
#include "modrig/messages/ResourceOverride.h"

namespace
{
constexpr const wchar_t* kTexts = L"ModrigLists.dll";
constexpr long kNoLanguage = 0;

void RegisterCommand(const wchar_t* name, TsEdCommandHandler handler, TsEdEntries entries, unsigned usage,
                     unsigned summary)
{
    const CStdStr group = CStdStr::OfId(ModrigMessages::kListsGroup);
    TsEdCommandStack* commands = TsEdCommandStack::cast(tsrxSysRegistry()->at(TSED_REGISTERED_COMMANDS));
    if (!commands || commands->addCommand(group.c_str(), name, name, 0, handler) != TSED_COMMAND_OK)
        return;
    tsedTakeArguments(group.c_str(), name, CStdStr::OfId(usage).c_str());
    tsedOfferEntries(group.c_str(), name, entries);
    tsedDescribeCommand(group.c_str(), name, CStdStr::OfId(summary).c_str());
}

int Load()
{
    if (!CTemporaryResourceOverride::SetDefaultResource(kNoLanguage, kTexts))
        return TSRX_RET_ERROR;
    const CTemporaryResourceOverride texts(CTemporaryResourceOverride::m_hInstanceDefault);
    using namespace ModrigMessages;
    RegisterCommand(L"SUITE", ModrigUtils::RunSuite, ModrigUtils::SuiteEntries, kSuiteUsage, kSuiteSummary);
    RegisterCommand(L"HISTORY", ModrigUtils::RunHistory, ModrigUtils::HistoryEntries, kHistoryUsage,
                    kHistorySummary);
    return TSRX_RET_OK;
}
} // namespace

extern "C" TESSEL_EXPORT int tsrxEntryPoint(unsigned message, void*)
{
    if (message == TSRX_MSG_LOAD)
        return Load();
    if (message == TSRX_MSG_UNLOAD)
        CTemporaryResourceOverride::ReleaseDefaultResource();
    return TSRX_RET_OK;
}

namespace ModrigUtils
{
// There is no dialog here.
void SetDialogMessage(const CStdStr&)
{
}
} // namespace ModrigUtils
