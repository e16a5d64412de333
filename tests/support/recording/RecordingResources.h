// Resource modules without files: a module is a name and its texts.
#pragma once

#include <list>
#include <map>
#include <memory>
#include <string>
#include <vector>

#include <wincompat/winres.h>

// An open module.
struct TsResourceModule
{
    std::wstring name;
    std::shared_ptr<std::map<unsigned, std::wstring>> texts;
};

class RecordingResources
{
public:
    using Texts = std::map<unsigned, std::wstring>;

    // From now on `LoadLibrary` finds a module by exactly this name, with either separator (a second call
    // replaces its texts).
    void addModule(const std::wstring& name, Texts texts);
    // From now on it does not; handles that are open keep their texts.
    void removeModule(const std::wstring& name);
    // One text of a module; seen through open handles too.
    void setText(const std::wstring& name, unsigned id, const std::wstring& text);
    void removeText(const std::wstring& name, unsigned id);

    // The names given to `LoadLibrary`, in order, those that were not found included.
    std::vector<std::wstring> requested;
    // The handles given to `FreeLibrary` and `AfxSetResourceHandle`, in order.
    std::vector<HMODULE> freed;
    std::vector<HMODULE> madeCurrent;

    // The module in which texts are looked up when none is named. A test may set it without a call.
    HMODULE current = nullptr;

    std::size_t openModules() const { return mOpen.size(); }
    bool isOpen(HMODULE module) const;
    // The name behind an open handle; empty for others.
    std::wstring nameOf(HMODULE module) const;

    // What the SDK's functions do. `load` is also how a test makes a module ready without journaling it.
    HMODULE load(const std::wstring& name);
    bool free(HMODULE module);
    // Null when the module is not open or has no such text.
    const std::wstring* text(HMODULE module, unsigned id) const;

private:
    std::map<std::wstring, std::shared_ptr<Texts>> mModules;
    std::list<TsResourceModule> mOpen;
};
