#include "tests/support/recording/RecordingResources.h"

#include <algorithm>
#include <cwchar>

#include "tests/support/RecordingHost.h"
#include "tests/support/recording/RecordingLoans.h"

namespace
{
std::wstring withSlashes(std::wstring name)
{
    std::replace(name.begin(), name.end(), L'\\', L'/');
    return name;
}
} // namespace

void RecordingResources::addModule(const std::wstring& name, Texts texts)
{
    if (const auto found = mModules.find(withSlashes(name)); found != mModules.end())
        *found->second = std::move(texts);
    else
        mModules[withSlashes(name)] = std::make_shared<Texts>(std::move(texts));
}

void RecordingResources::removeModule(const std::wstring& name)
{
    mModules.erase(withSlashes(name));
}

void RecordingResources::setText(const std::wstring& name, unsigned id, const std::wstring& text)
{
    (*mModules.at(withSlashes(name)))[id] = text;
}

void RecordingResources::removeText(const std::wstring& name, unsigned id)
{
    mModules.at(withSlashes(name))->erase(id);
}

bool RecordingResources::isOpen(HMODULE module) const
{
    return std::any_of(mOpen.begin(), mOpen.end(), [module](const auto& open) { return &open == module; });
}

std::wstring RecordingResources::nameOf(HMODULE module) const
{
    return isOpen(module) ? module->name : std::wstring();
}

HMODULE RecordingResources::load(const std::wstring& name)
{
    const auto found = mModules.find(withSlashes(name));
    return found == mModules.end() ? nullptr : &mOpen.emplace_back(TsResourceModule{name, found->second});
}

bool RecordingResources::free(HMODULE module)
{
    return mOpen.remove_if([module](const auto& open) { return &open == module; }) > 0;
}

const std::wstring* RecordingResources::text(HMODULE module, unsigned id) const
{
    if (!isOpen(module))
        return nullptr;
    const auto found = module->texts->find(id);
    return found == module->texts->end() ? nullptr : &found->second;
}

HMODULE LoadLibrary(const wchar_t* name)
{
    RecordingHost& host = recordingHost();
    host.journal.add(L"LoadLibrary", {name});
    host.resources.requested.emplace_back(name);
    const HMODULE module = host.resources.load(name);
    if (module)
        recording_loans::lend(module, "resource module");
    else
        host.output.say(std::wstring(L"Cannot open the resource module ") + name + L".");
    return module;
}

int FreeLibrary(HMODULE module)
{
    RecordingHost& host = recordingHost();
    host.journal.add(L"FreeLibrary", {host.resources.nameOf(module)});
    host.resources.freed.push_back(module);
    recording_loans::takeBack(module);
    return host.resources.free(module) ? 1 : 0;
}

HMODULE AfxGetResourceHandle()
{
    recordingHost().journal.add(L"AfxGetResourceHandle");
    return recordingHost().resources.current;
}

void AfxSetResourceHandle(HMODULE module)
{
    RecordingHost& host = recordingHost();
    host.journal.add(L"AfxSetResourceHandle", {host.resources.nameOf(module)});
    host.resources.madeCurrent.push_back(module);
    host.resources.current = module;
}

int loadStringFromWin32ResourceDLL(HMODULE module, unsigned id, wchar_t* buffer, int capacity)
{
    RecordingHost& host = recordingHost();
    host.journal.add(L"loadStringFromWin32ResourceDLL", {id});
    if (!buffer || capacity <= 0)
        return 0;
    const std::wstring* text = host.resources.text(module ? module : host.resources.current, id);
    const std::size_t length = text ? std::min(text->size(), static_cast<std::size_t>(capacity) - 1) : 0;
    if (text)
        std::wmemcpy(buffer, text->data(), length);
    buffer[length] = L'\0';
    return static_cast<int>(length);
}
