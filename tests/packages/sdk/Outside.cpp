#include <tessel/tsedcommands.h>
#include <tessel/tsformat.h>

extern "C" TESSEL_EXPORT int tsrxEntryPoint(unsigned message, void*)
{
    auto* commands = TsEdCommandStack::cast(tsrxSysRegistry()->at(TSED_REGISTERED_COMMANDS));
    if (message == TSRX_MSG_LOAD)
        commands->addCommand(L"OUTSIDE", L"OUTSIDE", L"OUTSIDE", 0,
                             [] { tsutPrintf(L"Hello from outside.\n"); });
    return TSRX_RET_OK;
}
