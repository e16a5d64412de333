// The host's dynamic linker: loads compiled applications, calls their entry points and takes them out again.
//
// Which application it is, is decided by the file, not by how its path is spelled: a link to a loaded file is
// loaded too. What a bundle maps is its program, so a bundle and the program inside it are the same
// application. A file that was replaced after it was loaded, as every build does, is recognised by where its
// path and the loaded one lead.
//
// An application that has answered message 2 is unloaded even if the system keeps its library mapped: it has
// given everything back, so it is listed no more and its commands are gone. That its code stays in memory is
// said, and a later load sends message 1 to the library that is still there.
#pragma once

#include <optional>
#include <set>
#include <span>
#include <string>
#include <vector>

#include <tessel/tsrxlinker.h>

#include "host/applications/LoadedModules.h"
#include "host/text/Result.h"

namespace tessel
{
class Admission;
class CallingApplication;
class CommandLine;
class CommandStack;
class LoadOutcomes;
class MessageBox;

// Loading fails when a function that the module needs is missing, not the call of it later.
inline constexpr bool kResolveNow = true;

class DynamicLinker : public TsRxDynamicLinker
{
public:
    struct LoadedModule
    {
        std::wstring path; // full
        std::wstring name; // the file name with its extension
        bool locked = false;
    };

    // Tells `calls` whose entry point runs, takes the commands of what goes out of `commands`, and notes how
    // loading came off. Loads what `admission` does not refuse. Command line and message box are for
    // applications, which learn no more than that something failed: a person gets to read why.
    DynamicLinker(CommandLine& commandLine, CallingApplication& calls, CommandStack& commands,
                  MessageBox& messageBox, LoadOutcomes& outcomes, Admission& admission);

    // Loads the file at the path. The failure is a whole sentence, or empty where the start has told it, with
    // the code of `Admission` if that has refused the file.
    Result<> load(const std::wstring& path, bool resolveNow);
    // Unloads the application at the path. An application of which a call has not returned yet stays, too:
    // its code is needed. The failure is a whole sentence; a success may have something to tell as well, or
    // an empty text.
    Result<std::wstring> unload(const std::wstring& path);

    bool registerApplication(void* application) override;
    bool loadModule(const wchar_t* path, bool sayWhyNot, bool resolveNow) override;
    bool unloadModule(const wchar_t* path, bool sayWhyNot) override;
    bool isModuleLocked(const wchar_t* path) const override;
    bool setApplicationLocked(void* application, bool locked) override;

    // Whether the application at the path counts as loaded.
    bool isModuleLoaded(const wchar_t* path) const;

    // What counts as loaded, in the order in which it came to.
    std::vector<LoadedModule> loadedModules() const;
    // Only their names; good until something is loaded or unloaded.
    std::span<const std::wstring_view> namesOfLoaded() const { return mModules.namesOfLoaded(); }

    // The full path of the first loaded application of that name, in any case; empty when there is none.
    std::wstring pathOfModule(const std::wstring& name) const;

    // The host ends: message 2 to everything, the last loaded first, whether locked or not. The libraries
    // stay mapped until the process ends, and nothing can be loaded any more.
    void unloadAll();

private:
    // What these say of a failure is the end of a sentence.
    Result<> attempt(const std::wstring& path, bool resolveNow);
    Result<> loadAdmitted(const std::wstring& path, bool resolveNow);
    Result<> loadNew(const std::wstring& path, bool resolveNow);
    Result<std::unique_ptr<Module>> open(const ModuleFile& file, const RegularFile& program,
                                         bool resolveNow) const;
    Result<> answerForKnown(const Module& module) const;
    Result<> start(Module& module);
    Result<> sendOff(Module* module);
    Result<> checkFreeToGo(const Module* module) const;
    Result<> send(Module& module, unsigned message) const;

    bool takeOut(Module& module);
    Module* find(const wchar_t* path) const;
    Module* known(const std::wstring& otherPath, const RegularFile& program) const;

    CommandLine& mCommandLine;
    CallingApplication& mCalls;
    CommandStack& mCommands;
    MessageBox& mMessageBox;
    LoadOutcomes& mOutcomes;
    Admission& mAdmission;
    LoadedModules mModules;
    // Libraries that threw while they were being mapped. The system keeps them, and would not make their
    // variables at another attempt.
    std::set<FileIdentity> mHalfMapped;
    bool mEnding = false;
};
} // namespace tessel
