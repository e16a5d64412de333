// The host's dynamic linker, as the module uses it.
#pragma once

#include <tessel/tsrxlinker.h>

#include "modrig/base/CStdStr.h"

namespace ModrigUtils
{
inline constexpr bool kSayWhyNot = true;
inline constexpr bool kResolveNow = true;

// The linker service, looked up again for every call of it: what loading runs may replace it. Null in a host
// without one.
[[nodiscard]] TsRxDynamicLinker* HostLinker();

// Whether the host keeps the module at the path from being unloaded.
[[nodiscard]] bool IsModuleLocked(const CStdStr& path);
} // namespace ModrigUtils
