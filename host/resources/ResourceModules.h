// The resource modules that applications have opened, and the one in which texts are looked up by default.
//
// A handle is never given out a second time, so a handle that was closed stays unknown for ever.
#pragma once

#include <map>
#include <string>
#include <vector>

#include <wincompat/winres.h>

#include "host/platform/RegularFile.h"
#include "host/resources/ModuleLanguages.h"
#include "host/resources/PeResources.h"

namespace tessel
{
class CallingApplication;

class ResourceModules
{
public:
    // `hostFolder`: where the host's own resources are. `languages`: the person's, the most wanted first.
    ResourceModules(std::wstring hostFolder, const CallingApplication& calls,
                    const std::vector<std::string>& languages);

    // Opens a module by its full path, or by a name looked for first in the resources of the application that
    // is being called (a bundle's; a plain library has its own folder) and then in the host's. A file that is
    // open already is opened once more under the same handle.
    Result<HMODULE> open(const wchar_t* name);

    // Undoes one `open`. False for a handle that is not open.
    bool close(HMODULE module);

    HMODULE current() const { return mCurrent; }
    void setCurrent(HMODULE module) { mCurrent = module; }

    // A text of the module (null: the current one), in the first of the person's languages in which the
    // module has it, else in the first of the module's own; empty when there is no such text or module.
    std::wstring string(HMODULE module, unsigned id) const;

private:
    struct Entry
    {
        FileIdentity identity;
        PeResources resources;
        std::vector<LanguageNumber> languages; // those of the resources, in the person's order
        unsigned references;
    };

    std::vector<std::wstring> placesOf(const std::wstring& name) const;
    Result<HMODULE> openFile(const RegularFile& file);

    std::wstring mHostFolder;
    const CallingApplication& mCalls;
    std::vector<LanguageNumber> mWantedLanguages;
    std::map<HMODULE, Entry> mEntries;
    std::uintptr_t mLastHandle;
    HMODULE mCurrent = nullptr;
};
} // namespace tessel
