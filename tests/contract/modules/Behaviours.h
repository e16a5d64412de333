// What the compiled applications of the contract tests do, each as an entry point. A host without libraries
// calls these functions; for a real one each becomes a library of its own (Module.cpp).
#pragma once

#include <tessel/tsed.h>
#include <tessel/tsedcommands.h>
#include <tessel/tsformat.h>
#include <tessel/tsrxlinker.h>

namespace contract_modules
{
inline constexpr wchar_t kGroup[] = L"CONTRACT";

// Nothing here may have a static in an inline function: such a symbol is unique in the process and keeps
// the library mapped.
namespace
{
TsRxDynamicLinker* linker()
{
    return TsRxDynamicLinker::cast(tsrxSysRegistry()->at(TSRX_DYNAMIC_LINKER));
}

void addCommand(const wchar_t* name, TsEdCommandHandler handler)
{
    TsEdCommandStack* commands = TsEdCommandStack::cast(tsrxSysRegistry()->at(TSED_REGISTERED_COMMANDS));
    commands->addCommand(kGroup, name, name, 0, handler);
}

[[maybe_unused]] int plain(unsigned message, void*)
{
    tsutPrintf(L"<message %u>\n", message);
    return TSRX_RET_OK;
}

[[maybe_unused]] int refusesToLoad(unsigned message, void*)
{
    return message == TSRX_MSG_LOAD ? TSRX_RET_ERROR : TSRX_RET_OK;
}

[[maybe_unused]] int refusesToUnload(unsigned message, void*)
{
    return message == TSRX_MSG_UNLOAD ? TSRX_RET_ERROR : TSRX_RET_OK;
}

void* handleOfLocked = nullptr;

[[maybe_unused]] int locksItself(unsigned message, void* application)
{
    if (message == TSRX_MSG_LOAD)
    {
        handleOfLocked = application;
        tsutPrintf(linker()->setApplicationLocked(application, true) ? L"<locked>\n" : L"<not locked>\n");
        addCommand(L"CONTRACTUNLOCK", [] { linker()->setApplicationLocked(handleOfLocked, false); });
    }
    return TSRX_RET_OK;
}

bool isListed()
{
    TsResultBuffer* modules = tsedQmbLoaded();
    const bool listed = modules != nullptr;
    tsutRelRb(modules);
    return listed;
}

[[maybe_unused]] int registersItself(unsigned message, void* application)
{
    if (message != TSRX_MSG_LOAD)
        return TSRX_RET_OK;
    tsutPrintf(isListed() ? L"<listed early>\n" : L"<not listed yet>\n");
    tsutPrintf(linker()->registerApplication(application) ? L"<registered>\n" : L"<unknown>\n");
    tsutPrintf(isListed() ? L"<listed>\n" : L"<missing>\n");
    // A second message 1 would print all this again.
    tsutPrintf(linker()->loadModule(tsedGetAppName(), true, true) ? L"<loaded already>\n" : L"<failed>\n");
    return TSRX_RET_OK;
}

[[maybe_unused]] int tellsItsName(unsigned message, void*)
{
    if (message == TSRX_MSG_LOAD)
        addCommand(L"CONTRACTNAME", [] { tsutPrintf(L"<command of %s>\n", tsedGetAppName()); });
    tsutPrintf(L"<message %u to %s>\n", message, tsedGetAppName());
    return TSRX_RET_OK;
}
} // namespace
} // namespace contract_modules
