#include "modrig/loader/HostLinker.h"

namespace ModrigUtils
{
TsRxDynamicLinker* HostLinker()
{
    return TsRxDynamicLinker::cast(tsrxSysRegistry()->at(TSRX_DYNAMIC_LINKER));
}

bool IsModuleLocked(const CStdStr& path)
{
    const TsRxDynamicLinker* linker = HostLinker();
    return linker && linker->isModuleLocked(path.c_str());
}
} // namespace ModrigUtils
