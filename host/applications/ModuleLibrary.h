// The library of one compiled application, mapped into the process.
#pragma once

#include <memory>
#include <string>

#include <tessel/tsrx.h>

namespace tessel
{
// What stands at the path of an application.
struct ModuleFile
{
    std::string path;    // full, without a separator at its end
    std::string program; // the file that is mapped: the path itself, or the program inside the bundle
    bool isBundle = false;
    std::wstring whyNoProgram; // the end of a sentence, where a bundle stands at the path that cannot be used
};

// What stands at a full path.
ModuleFile moduleFileAt(std::string path);

class ModuleLibrary
{
public:
    // Maps the file, which has been checked. Null when the system refuses: `whyNot` is then the end of a
    // sentence, in the system's own words.
    static std::unique_ptr<ModuleLibrary> open(const ModuleFile& file, bool resolveNow, std::wstring& whyNot);

    // Leaves the library mapped.
    ~ModuleLibrary() = default;
    ModuleLibrary(const ModuleLibrary&) = delete;
    ModuleLibrary& operator=(const ModuleLibrary&) = delete;

    // Null when the library has none.
    TsRxEntryPoint entryPoint() const;

    // Takes the library out of the process. Called once; false when the system keeps it mapped.
    bool close();

private:
    ModuleLibrary(ModuleFile file, void* handle, bool byPlatform);
    static std::unique_ptr<ModuleLibrary> openBundle(const ModuleFile& file, bool resolveNow,
                                                     std::wstring& whyNot);

    ModuleFile mFile;
    void* mHandle;
    bool mByPlatform; // mapped by the platform's bundle class
};
} // namespace tessel
