#include "modrig/loader/KeptOut.h"

#include <tessel/tsrxkeptout.h>

namespace ModrigUtils
{
namespace
{
TsRxKeptOut* Service()
{
    return TsRxKeptOut::cast(tsrxSysRegistry()->at(TSRX_KEPT_OUT));
}
} // namespace

bool HostKeepsApplicationsOut()
{
    return Service() != nullptr;
}

CStdStr WhyKeptOut(const CStdStr& path)
{
    TsRxKeptOut* service = Service();
    const wchar_t* why = service ? service->whyKeptOut(path.c_str()) : nullptr;
    return why ? CStdStr(why) : CStdStr();
}

void KeepOut(const CStdStr& path)
{
    if (TsRxKeptOut* service = Service())
        static_cast<void>(service->keepOut(path.c_str()));
}

void LetIn(const CStdStr& path)
{
    if (TsRxKeptOut* service = Service())
        static_cast<void>(service->letIn(path.c_str()));
}
} // namespace ModrigUtils
