// The SDK's functions about resource modules.
#include <algorithm>
#include <string>

#include <wincompat/winres.h>

#include "host/resources/ResourceModules.h"
#include "host/text/CommandLine.h"
#include "host/text/Running.h"

HMODULE LoadLibrary(const wchar_t* name)
{
    auto* modules = tessel::running<tessel::ResourceModules>();
    if (!modules)
        return nullptr;
    const auto module = modules->open(name);
    return tessel::running<tessel::CommandLine>()->tell(module) ? *module : nullptr;
}

int FreeLibrary(HMODULE module)
{
    auto* modules = tessel::running<tessel::ResourceModules>();
    return modules && modules->close(module) ? 1 : 0;
}

HMODULE AfxGetResourceHandle()
{
    const auto* modules = tessel::running<tessel::ResourceModules>();
    return modules ? modules->current() : nullptr;
}

void AfxSetResourceHandle(HMODULE module)
{
    if (auto* modules = tessel::running<tessel::ResourceModules>())
        modules->setCurrent(module);
}

int loadStringFromWin32ResourceDLL(HMODULE module, unsigned id, wchar_t* buffer, int capacity)
{
    const auto* modules = tessel::running<tessel::ResourceModules>();
    if (!buffer || capacity <= 0)
        return 0;
    const std::wstring text = modules ? modules->string(module, id) : std::wstring();
    const std::size_t length = std::min(text.size(), static_cast<std::size_t>(capacity) - 1);
    std::copy_n(text.begin(), length, buffer);
    buffer[length] = L'\0';
    return static_cast<int>(length);
}
