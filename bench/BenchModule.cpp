// A module as small as modules get.
#include <tessel/tsrx.h>

extern "C" TESSEL_EXPORT int tsrxEntryPoint(unsigned, void*)
{
    return TSRX_RET_OK;
}
