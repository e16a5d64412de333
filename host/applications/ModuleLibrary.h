// The library of one compiled application, mapped into the process.
#pragma once

#include <memory>
#include <string>

#include <tessel/tsrx.h>

#include "host/platform/RegularFile.h"
#include "host/text/Result.h"

namespace tessel
{
// What stands at the path of an application.
struct ModuleFile
{
    std::string path;    // full, without a separator at its end
    std::string program; // the file that is mapped: the path itself, or the program inside the bundle
    bool isBundle = false;
};

// What stands at a full path; why a bundle there cannot be used is the end of a sentence.
Result<ModuleFile> moduleFileAt(std::string path);

class ModuleLibrary
{
public:
    // Maps the file, which has been checked. Why the system refuses is the end of a sentence, in its own
    // words.
    //
    // Variables that are made and classes that are loaded on the way may throw, which has a code of its own:
    // the library then stays in memory, half made. The system's linker is also left with its lock on this
    // thread, so that another thread that wants something from it waits to the end of the session.
    static constexpr int kThrew = 2;
    static Result<std::unique_ptr<ModuleLibrary>> open(const ModuleFile& file, bool resolveNow);

    // Leaves the library mapped.
    ~ModuleLibrary() = default;
    ModuleLibrary(const ModuleLibrary&) = delete;
    ModuleLibrary& operator=(const ModuleLibrary&) = delete;

    // Whether this is the file's code that is in memory, and the file is as long as it was when it was
    // opened.
    bool isFrom(const RegularFile& program) const;

    // Null when the library has none.
    TsRxEntryPoint entryPoint() const;

    // Takes the library out of the process. Called once; false when the system keeps it mapped.
    bool close();

private:
    ModuleLibrary(ModuleFile file, void* handle, bool byPlatform);
    static Result<std::unique_ptr<ModuleLibrary>> openUnguarded(const ModuleFile& file, bool resolveNow);
    static Result<std::unique_ptr<ModuleLibrary>> openBundle(const ModuleFile& file, bool resolveNow);

    ModuleFile mFile;
    void* mHandle;
    bool mByPlatform; // mapped by the platform's bundle class
};
} // namespace tessel
