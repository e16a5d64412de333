// The SDK's functions about loaded modules.
#include <algorithm>
#include <string>

#include <tessel/tsed.h>

#include "host/applications/DynamicLinker.h"
#include "host/text/ResultBuffers.h"
#include "host/text/Running.h"

namespace
{
constexpr int kFound = 0;
constexpr int kNotFound = 1;
} // namespace

TsResultBuffer* tsedQmbLoaded()
{
    const auto* linker = tessel::running<tessel::DynamicLinker>();
    return linker ? tessel::listOfTexts(linker->namesOfLoaded()) : nullptr;
}

int tsedGetModuleFileName(const wchar_t* moduleName, wchar_t* path, std::size_t capacity)
{
    const auto* linker = tessel::running<tessel::DynamicLinker>();
    if (!linker || !moduleName || !path)
        return kNotFound;
    const std::wstring found = linker->pathOfModule(moduleName);
    if (found.empty() || found.size() >= capacity)
        return kNotFound;
    std::copy_n(found.c_str(), found.size() + 1, path);
    return kFound;
}
