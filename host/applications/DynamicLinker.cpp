#include "host/applications/DynamicLinker.h"

#include <algorithm>
#include <exception>
#include <filesystem>
#include <ranges>
#include <utility>

#include "host/Services.h"
#include "host/applications/ImageCheck.h"
#include "host/commands/CallingApplication.h"
#include "host/commands/CommandStack.h"
#include "host/messages/MessageBox.h"
#include "host/platform/ObjectiveCGuard.h"
#include "host/text/CommandLine.h"
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

// Where the path leads through all links; itself where nothing stands.
std::wstring realPathOf(const std::wstring& path)
{
    std::error_code failed;
    const auto real = std::filesystem::canonical(toUtf8(path), failed);
    return failed ? path : toWide(real.native());
}

std::wstring nameIn(const std::wstring& path)
{
    return path.substr(path.rfind(kSeparator) + 1);
}

void say(const std::wstring& path, const wchar_t* whatFailed, const std::wstring& whyNot)
{
    services().commandLine->say(L"The application \"" + path + L"\" " + whatFailed + whyNot + L".");
}

std::wstring whyNotLoadable(const ModuleFile& file, const RegularFile& program)
{
    if (!file.whyNoProgram.empty())
        return file.whyNoProgram;
    if (!program.isOpen())
        return program.whyNot();
    const auto read = [&](std::uint64_t offset, void* buffer, std::size_t size)
    {
        return program.read(offset, buffer, size);
    };
    return std::wstring(whyNotMappable(program.size(), read));
}

std::unique_ptr<Module> open(const ModuleFile& file, bool resolveNow, std::wstring& whyNot)
{
    auto module = std::make_unique<Module>();
    module->library = ModuleLibrary::open(file, resolveNow, whyNot);
    if (!module->library)
        return nullptr;
    module->entryPoint = module->library->entryPoint();
    return module;
}
} // namespace

bool DynamicLinker::registerApplication(void* application)
{
    Module* module = mModules.withHandle(application);
    if (module)
        mModules.putInService(*module);
    return module != nullptr;
}

bool DynamicLinker::loadModule(const wchar_t* path, bool sayWhyNot, bool resolveNow)
{
    const std::wstring fullPath = fullPathOf(path);
    std::wstring whyNot;
    if (load(fullPath, resolveNow, whyNot))
        return true;
    if (auto* box = services().messageBox)
        box->explain(fullPath, whyNot + L".");
    if (sayWhyNot)
        say(fullPath, L"is not loaded: ", whyNot);
    return false;
}

bool DynamicLinker::load(const std::wstring& path, bool resolveNow, std::wstring& whyNot)
{
    if (mEnding)
    {
        whyNot = L"the host is ending";
        return false;
    }
    if (const Module* known = mModules.withPath(path))
        return answerForKnown(*known, whyNot);
    const ModuleFile file = moduleFileAt(toUtf8(path));
    const RegularFile program(file.program);
    const std::wstring realPath = realPathOf(path);
    if (const Module* loaded = known(realPath, program))
        return answerForKnown(*loaded, whyNot);
    whyNot = whyNotLoadable(file, program);
    if (!whyNot.empty())
        return false;
    auto opened = open(file, resolveNow, whyNot);
    if (!opened)
        return false;
    opened->path = path;
    opened->realPath = realPath;
    opened->name = nameIn(path);
    opened->identity = program.identity();
    return start(mModules.add(std::move(opened)), whyNot);
}

bool DynamicLinker::answerForKnown(const Module& module, std::wstring& whyNot) const
{
    if (!module.inService)
        whyNot = L"its load message is still running, and it has not registered itself";
    return module.inService;
}

bool DynamicLinker::start(Module& module, std::wstring& whyNot)
{
    if (!module.entryPoint)
        whyNot = L"it has no entry point \"tsrxEntryPoint\"";
    else if (send(module, TSRX_MSG_LOAD, whyNot))
    {
        mModules.putInService(module);
        return true;
    }
    // Why it was not loaded is what a person needs to know; whether it is still mapped matters to nobody.
    static_cast<void>(takeOut(module));
    return false;
}

bool DynamicLinker::send(Module& module, unsigned message, std::wstring& whyNot) const
{
    const CallingApplication::Scope calling(*services().callingApplication, module.path);
    int answer = TSRX_RET_OK;
    try
    {
        const auto thrown = catchObjectiveC([&] { answer = module.entryPoint(message, &module); });
        if (thrown)
            whyNot = L"its entry point threw an exception: " + *thrown;
        else if (answer != TSRX_RET_OK)
            whyNot = L"its entry point answered " + std::to_wstring(answer);
    }
    catch (const std::exception& error)
    {
        whyNot = L"its entry point threw an exception: " + toWide(error.what());
    }
    catch (...)
    {
        whyNot = L"its entry point threw something that is not an error of the standard library";
    }
    return whyNot.empty();
}

bool DynamicLinker::unloadModule(const wchar_t* path, bool sayWhyNot)
{
    const std::wstring fullPath = fullPathOf(path);
    Module* module = find(path);
    std::wstring whyNot;
    if (!isFreeToGo(module, whyNot) || !send(*module, TSRX_MSG_UNLOAD, whyNot))
    {
        if (sayWhyNot)
            say(fullPath, L"is not unloaded: ", whyNot);
        return false;
    }
    if (!takeOut(*module) && sayWhyNot)
        say(fullPath, L"is out of service; ", L"its code stays in memory until the session ends");
    return true;
}

bool DynamicLinker::isFreeToGo(const Module* module, std::wstring& whyNot) const
{
    if (!module || !module->inService)
        whyNot = L"it is not loaded";
    else if (module->locked)
        whyNot = L"it is locked";
    else if (services().callingApplication->isAtWork(module->path))
        whyNot = L"it is at work";
    return whyNot.empty();
}

// False when the system keeps the library mapped.
bool DynamicLinker::takeOut(Module& module)
{
    services().commands->removeCommandsOf(module.path);
    const bool closed = module.library->close();
    mModules.remove(module);
    return closed;
}

Module* DynamicLinker::find(const wchar_t* path) const
{
    const std::wstring fullPath = fullPathOf(path);
    if (Module* module = mModules.withPath(fullPath))
        return module;
    const RegularFile program(moduleFileAt(toUtf8(fullPath)).program);
    return known(realPathOf(fullPath), program);
}

Module* DynamicLinker::known(const std::wstring& realPath, const RegularFile& program) const
{
    if (Module* module = mModules.withPath(realPath))
        return module;
    return program.isOpen() ? mModules.withIdentity(program.identity()) : nullptr;
}

bool DynamicLinker::isModuleLocked(const wchar_t* path) const
{
    const Module* module = find(path);
    return module && module->inService && module->locked;
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
    return module && module->inService;
}

std::vector<DynamicLinker::LoadedModule> DynamicLinker::loadedModules() const
{
    std::vector<LoadedModule> result;
    for (const Module* module : mModules.inService())
        result.push_back({module->path, module->name, module->locked});
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
    while (!mModules.inService().empty())
    {
        Module& last = *mModules.inService().back();
        std::wstring whyNot;
        if (!send(last, TSRX_MSG_UNLOAD, whyNot))
            say(last.path, L"did not end as it should: ", whyNot);
        services().commands->removeCommandsOf(last.path);
        mModules.remove(last);
    }
}
} // namespace tessel
