#include "host/applications/DynamicLinker.h"

#include <algorithm>
#include <filesystem>
#include <ranges>
#include <utility>

#include "host/applications/Admission.h"
#include "host/applications/ApplicationFiles.h"
#include "host/applications/ExceptionGuard.h"
#include "host/applications/LoadOutcomes.h"
#include "host/applications/SdkVersion.h"
#include "host/commands/CallingApplication.h"
#include "host/commands/CommandStack.h"
#include "host/messages/MessageBox.h"
#include "host/platform/ImageCheck.h"
#include "host/platform/RealPath.h"
#include "host/text/CommandLine.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"

bool TsRxDynamicLinker::isKindOf(const wchar_t* className) const
{
    return className && std::wstring_view(className) == kClassName;
}

namespace tessel
{
namespace
{
constexpr wchar_t kSeparator = L'/';

// The path from the root of the file system on, without a separator at its end.
std::wstring fullPathOf(const wchar_t* path)
{
    std::wstring full = path ? path : L"";
    while (full.size() > 1 && full.ends_with(kSeparator))
        full.pop_back();
    if (full.empty() || full.starts_with(kSeparator))
        return full;
    std::error_code failed; // the current folder may be gone: the path then stays as it is
    const auto folder = std::filesystem::current_path(failed);
    return failed ? full : toWide(folder.native()) + kSeparator + full;
}

// Whether the path comes from the root of the file system with no part that is a detour: empty, "." or "..".
bool isStraight(std::wstring_view path)
{
    if (!path.starts_with(kSeparator))
        return false;
    while (!path.empty())
    {
        path.remove_prefix(1); // the separator
        const std::wstring_view part = path.substr(0, path.find(kSeparator));
        if (part.empty() || part == L"." || part == L"..")
            return false;
        path.remove_prefix(part.size());
    }
    return true;
}

// Where the full path leads through all links, if that is elsewhere; empty if not. To follow links costs as
// much as all other looks at the file, and is left out where opening it has shown that there are none.
std::wstring otherPathOf(const std::wstring& path, const Result<ModuleFile>& file, const RegularFile& program)
{
    if (file && !file->isBundle && program.reachedDirectly() && isStraight(path))
        return {};
    auto real = toWide(realPath(toUtf8(path)).native());
    return real == path ? std::wstring() : real;
}

Result<> checkLoadable(const RegularFile& program)
{
    auto mappable = checkMappable(program);
    return mappable ? checkSdkVersion(sdkVersionIn(program.size(), readerOf(program))) : mappable;
}

// What is wrong with the program in a bundle.
Failure ofProgram(const ModuleFile& file, const Result<>& loadable)
{
    return {
        translated(L"its program \"{}\" cannot be used, since {}", toWide(file.program), loadable.sentence()),
        loadable.code()};
}

// Of a file that is no library, its name may say what it is.
Result<> whyNotLoadable(const ModuleFile& file, const RegularFile& program, const Result<>& loadable)
{
    if (file.isBundle)
        return ofProgram(file, loadable);
    const auto kind = checkKindIsLoaded(file.path);
    return program.opened() && !kind ? kind : loadable;
}

// What a person is told of an attempt.
Result<> whole(const std::wstring& path, const Result<>& attempted)
{
    if (attempted)
        return attempted;
    if (attempted.code() == Admission::kAlreadyTold)
        return Failure{{}, attempted.code()};
    return Failure{translated(L"The application \"{}\" is not loaded: {}.", path, attempted.sentence()),
                   attempted.code()};
}

// The program at a path, or a file that is not open.
RegularFile programOf(const Result<ModuleFile>& file)
{
    return RegularFile(file ? file->program : std::string());
}
} // namespace

DynamicLinker::DynamicLinker(CommandLine& commandLine, CallingApplication& calls, CommandStack& commands,
                             MessageBox& messageBox, LoadOutcomes& outcomes, Admission& admission)
    : mCommandLine(commandLine), mCalls(calls), mCommands(commands), mMessageBox(messageBox),
      mOutcomes(outcomes), mAdmission(admission)
{
}

bool DynamicLinker::registerApplication(void* application)
{
    Module* module = mModules.withHandle(application);
    if (module)
        mModules.countAsLoaded(*module);
    return module != nullptr;
}

Result<> DynamicLinker::load(const std::wstring& path, bool resolveNow)
{
    const std::wstring fullPath = fullPathOf(path.c_str());
    return whole(fullPath, attempt(fullPath, resolveNow));
}

// The application that has asked may show a box of its own about the failure, which it knows of by a bool:
// the reason cannot come with it, so the box is told beforehand.
bool DynamicLinker::loadModule(const wchar_t* path, bool sayWhyNot, bool resolveNow)
{
    const std::wstring fullPath = fullPathOf(path);
    const auto loaded = attempt(fullPath, resolveNow);
    if (loaded)
        return true;
    if (Admission::isKeptOut(loaded.code()))
        mMessageBox.passOver(fullPath);
    else
        mMessageBox.explain(fullPath, loaded.sentence() + L".");
    if (sayWhyNot && !mOutcomes.willBeTold(loaded.code()))
        mCommandLine.tell(whole(fullPath, loaded));
    return false;
}

Result<> DynamicLinker::attempt(const std::wstring& path, bool resolveNow)
{
    const Module* wasKnown = mModules.withPath(path);
    const auto begun = LoadOutcomes::Clock::now();
    auto loaded = wasKnown && !mEnding ? answerForKnown(*wasKnown) : loadAdmitted(path, resolveNow);
    // By a link to what is there already nothing is loaded.
    if (!loaded || (!wasKnown && mModules.withPath(path)))
        mOutcomes.note(path, loaded, begun);
    return loaded;
}

Result<> DynamicLinker::loadAdmitted(const std::wstring& path, bool resolveNow)
{
    if (mEnding)
        return Failure{translated(L"the host is ending")};
    if (auto admitted = mAdmission.check(path); !admitted)
        return admitted;
    auto loaded = loadNew(path, resolveNow);
    if (loaded)
        mAdmission.noteLoaded(path);
    return loaded;
}

Result<> DynamicLinker::loadNew(const std::wstring& path, bool resolveNow)
{
    const auto file = moduleFileAt(toUtf8(path));
    const RegularFile program = programOf(file);
    std::wstring otherPath = otherPathOf(path, file, program);
    if (const Module* loaded = known(otherPath, program))
        return answerForKnown(*loaded);
    if (!file)
        return file.failure();
    if (auto loadable = checkLoadable(program); !loadable)
        return whyNotLoadable(*file, program, loadable);
    if (mHalfMapped.contains(program.identity()))
        return Failure{translated(L"it threw an exception before while it was being mapped, and what is in "
                                  L"memory of it since cannot be used")};
    auto opened = open(*file, program, resolveNow);
    if (opened.code() == ModuleLibrary::kThrew)
        mHalfMapped.insert(program.identity());
    if (!opened)
        return opened.failure();
    std::unique_ptr<Module> module = *std::move(opened);
    module->path = path;
    module->otherPath = std::move(otherPath);
    module->identity = program.identity();
    return start(mModules.add(std::move(module)));
}

// The path may have come to lead to another file since the program was checked, or the system may hold an
// earlier file of that path. Constructors may load others; nobody has asked for those by name.
Result<std::unique_ptr<Module>> DynamicLinker::open(const ModuleFile& file, const RegularFile& program,
                                                    bool resolveNow) const
{
    const RunningMarker::Scope loading(mCalls.marker(), RunningMarker::Deed::kLoading, file.path);
    const RunningMarker::ReasonScope forIt(mCalls.marker(), RunningMarker::Reason::kForAnother);
    auto library = ModuleLibrary::open(file, resolveNow);
    if (!library)
        return library.failure();
    if (!(*library)->isFrom(program))
        return Failure{
            (*library)->close()
                ? translated(L"its file was replaced while it was being loaded")
                : translated(L"the code of another file is in memory in its place, until the session ends")};
    auto module = std::make_unique<Module>();
    module->library = *std::move(library);
    module->entryPoint = module->library->entryPoint();
    return module;
}

Result<> DynamicLinker::answerForKnown(const Module& module) const
{
    if (module.isLoaded)
        return {};
    return Failure{translated(L"its load message is still running, and it has not registered itself")};
}

Result<> DynamicLinker::start(Module& module)
{
    auto started = module.entryPoint ? send(module, TSRX_MSG_LOAD)
                                     : Failure{translated(L"it has no entry point \"tsrxEntryPoint\"")};
    if (started)
        mModules.countAsLoaded(module);
    else
        // Why it was not loaded is what a person needs to know; whether it is still mapped matters to nobody.
        static_cast<void>(takeOut(module));
    return started;
}

Result<> DynamicLinker::send(Module& module, unsigned message) const
{
    const CallingApplication::Scope calling(mCalls, module.path,
                                            message == TSRX_MSG_UNLOAD ? RunningMarker::Deed::kUnloading
                                                                       : RunningMarker::Deed::kEntryPoint);
    const RunningMarker::ReasonScope forIt(mCalls.marker(), RunningMarker::Reason::kForAnother);
    int answer = TSRX_RET_OK;
    if (const auto returned = catchAnything([&] { answer = module.entryPoint(message, &module); }); !returned)
        return Failure{translated(L"its entry point threw {}", returned.sentence())};
    if (answer != TSRX_RET_OK)
        return Failure{translated(L"its entry point answered {}", answer)};
    return {};
}

Result<std::wstring> DynamicLinker::unload(const std::wstring& path)
{
    const std::wstring fullPath = fullPathOf(path.c_str());
    Module* module = find(fullPath.c_str());
    if (const auto gone = sendOff(module); !gone)
        return Failure{translated(L"The application \"{}\" is not unloaded: {}.", fullPath, gone.sentence())};
    if (takeOut(*module))
        return std::wstring();
    return translated(L"The application \"{}\" is out of service; its code stays in memory until the session "
                      L"ends.",
                      fullPath);
}

bool DynamicLinker::unloadModule(const wchar_t* path, bool sayWhyNot)
{
    const auto unloaded = unload(path ? path : L"");
    const std::wstring& told = unloaded ? *unloaded : unloaded.sentence();
    if (sayWhyNot && !told.empty())
        mCommandLine.say(told);
    return static_cast<bool>(unloaded);
}

// Message 2, to one that may go.
Result<> DynamicLinker::sendOff(Module* module)
{
    auto free = checkFreeToGo(module);
    return free ? send(*module, TSRX_MSG_UNLOAD) : free;
}

Result<> DynamicLinker::checkFreeToGo(const Module* module) const
{
    if (!module || !module->isLoaded)
        return Failure{translated(L"it is not loaded")};
    if (module->locked)
        return Failure{translated(L"it is locked")};
    if (mCalls.isAtWork(module->path))
        return Failure{translated(L"it is at work")};
    return {};
}

// False when the system keeps the library mapped.
bool DynamicLinker::takeOut(Module& module)
{
    mCommands.removeCommandsOf(module.path);
    const RunningMarker::Scope closing(mCalls.marker(), RunningMarker::Deed::kUnloading, toUtf8(module.path));
    const bool closed = module.library->close();
    mModules.remove(module);
    return closed;
}

Module* DynamicLinker::find(const wchar_t* path) const
{
    const std::wstring fullPath = fullPathOf(path);
    if (Module* module = mModules.withPath(fullPath))
        return module;
    const auto file = moduleFileAt(toUtf8(fullPath));
    const RegularFile program = programOf(file);
    return known(otherPathOf(fullPath, file, program), program);
}

Module* DynamicLinker::known(const std::wstring& otherPath, const RegularFile& program) const
{
    if (Module* module = otherPath.empty() ? nullptr : mModules.withPath(otherPath))
        return module;
    return program.opened() ? mModules.withIdentity(program.identity()) : nullptr;
}

bool DynamicLinker::isModuleLocked(const wchar_t* path) const
{
    const Module* module = find(path);
    return module && module->isLoaded && module->locked;
}

bool DynamicLinker::setApplicationLocked(void* application, bool locked)
{
    Module* module = mModules.withHandle(application);
    if (module)
        module->locked = locked;
    return module != nullptr;
}

bool DynamicLinker::isModuleLoaded(const wchar_t* path) const
{
    const Module* module = find(path);
    return module && module->isLoaded;
}

std::vector<DynamicLinker::LoadedModule> DynamicLinker::loadedModules() const
{
    std::vector<LoadedModule> result;
    for (const Module* module : mModules.loaded())
        result.push_back({module->path, std::wstring(module->name()), module->locked});
    return result;
}

std::wstring DynamicLinker::pathOfModule(const std::wstring& name) const
{
    const Module* module = mModules.named(name);
    return module ? module->path : std::wstring();
}

void DynamicLinker::unloadAll()
{
    mEnding = true;
    while (!mModules.loaded().empty())
    {
        Module& last = *mModules.loaded().back();
        if (const auto ended = send(last, TSRX_MSG_UNLOAD); !ended)
            mCommandLine.say(translated(L"The application \"{}\" did not end as it should: {}.", last.path,
                                        ended.sentence()));
        mCommands.removeCommandsOf(last.path);
        mModules.remove(last);
    }
}
} // namespace tessel
