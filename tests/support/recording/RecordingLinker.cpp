#include "tests/support/recording/RecordingLinker.h"

#include "tests/support/RecordingHost.h"

namespace
{
// The entry point is a copy: it may give its own path another one.
int callEntryPoint(RecordingLinker::EntryPoint entryPoint, const std::wstring& path, unsigned message,
                   void* application)
{
    if (!entryPoint)
        return TSRX_RET_OK;
    const RecordingCaller caller(path);
    return entryPoint(message, application);
}

// An empty reason is success.
bool report(const wchar_t* what, const std::wstring& path, const std::wstring& reason, bool sayWhyNot)
{
    if (reason.empty())
        return true;
    if (sayWhyNot)
        recordingHost().output.say(std::wstring(L"Cannot ") + what + L" " + path + L": " + reason + L".");
    return false;
}
} // namespace

void RecordingLinker::setLoaded(const std::wstring& path)
{
    countAsLoaded(application(path));
}

void RecordingLinker::setLocked(const std::wstring& path, bool locked)
{
    setLoaded(path);
    application(path).locked = locked;
}

void RecordingLinker::refuseToLoad(const std::wstring& path, const std::wstring& reason)
{
    application(path).whyItDoesNotLoad = reason;
}

void RecordingLinker::refuseToUnload(const std::wstring& path, const std::wstring& reason)
{
    application(path).whyItDoesNotUnload = reason;
}

void RecordingLinker::allow(const std::wstring& path)
{
    refuseToLoad(path, {});
    refuseToUnload(path, {});
}

void RecordingLinker::keepMapped(const std::wstring& path)
{
    application(path).staysMapped = true;
}

void RecordingLinker::setEntryPoint(const std::wstring& path, EntryPoint entryPoint)
{
    application(path).entryPoint = std::move(entryPoint);
}

bool RecordingLinker::isLoaded(const std::wstring& path) const
{
    const Application* found = find(path);
    return found && found->loaded;
}

void* RecordingLinker::handleOf(const std::wstring& path)
{
    return &application(path);
}

bool RecordingLinker::registerApplication(void* handle)
{
    recordingHost().journal.add(L"registerApplication");
    registeredHandles.push_back(handle);
    Application* found = find(handle);
    if (found)
        countAsLoaded(*found);
    return found != nullptr;
}

bool RecordingLinker::loadModule(const wchar_t* path, bool sayWhyNot, bool resolveNow)
{
    recordingHost().journal.add(L"loadModule", {path, sayWhyNot, resolveNow});
    calls.push_back({Call::Operation::kLoad, path, sayWhyNot, resolveNow});
    Application& wanted = application(path);
    return wanted.loaded || report(L"load", path, load(wanted), sayWhyNot);
}

bool RecordingLinker::unloadModule(const wchar_t* path, bool sayWhyNot)
{
    recordingHost().journal.add(L"unloadModule", {path, sayWhyNot});
    calls.push_back({Call::Operation::kUnload, path, sayWhyNot, false});
    Application& leaving = application(path);
    const bool unloaded = report(L"unload", path, unload(leaving), sayWhyNot);
    if (unloaded && leaving.staysMapped && sayWhyNot)
        recordingHost().output.say(std::wstring(path) + L" stays in memory.");
    return unloaded;
}

bool RecordingLinker::isModuleLocked(const wchar_t* path) const
{
    RecordingHost& host = recordingHost();
    host.journal.add(L"isModuleLocked", {path});
    host.linker.calls.push_back({Call::Operation::kIsLocked, path, false, false});
    const Application* found = find(std::wstring(path));
    return found && found->locked;
}

bool RecordingLinker::setApplicationLocked(void* handle, bool locked)
{
    recordingHost().journal.add(L"setApplicationLocked", {locked});
    Application* found = find(handle);
    if (found)
        found->locked = locked;
    return found != nullptr;
}

RecordingLinker::Application& RecordingLinker::application(const std::wstring& path)
{
    Application& found = mApplications[path];
    found.path = path;
    return found;
}

const RecordingLinker::Application* RecordingLinker::find(const std::wstring& path) const
{
    const auto found = mApplications.find(path);
    return found == mApplications.end() ? nullptr : &found->second;
}

RecordingLinker::Application* RecordingLinker::find(const void* handle)
{
    for (auto& [path, candidate] : mApplications)
        if (&candidate == handle)
            return &candidate;
    return nullptr;
}

void RecordingLinker::countAsLoaded(Application& loaded)
{
    if (!loaded.loaded)
        recordingHost().loadedModules.add(loaded.path);
    loaded.loaded = true;
}

void RecordingLinker::forget(Application& gone)
{
    gone.loaded = false;
    gone.locked = false;
    recordingHost().loadedModules.remove(gone.path);
    recordingHost().commands.removeCommandsOf(gone.path);
}

std::wstring RecordingLinker::load(Application& wanted)
{
    if (!wanted.whyItDoesNotLoad.empty())
        return wanted.whyItDoesNotLoad;
    if (!mLoadsAnything && !wanted.entryPoint)
        return L"there is no such file";
    if (wanted.loading)
        return L"its load message is still running";
    wanted.loading = true;
    const int answer = callEntryPoint(wanted.entryPoint, wanted.path, TSRX_MSG_LOAD, &wanted);
    wanted.loading = false;
    if (answer != TSRX_RET_OK)
    {
        forget(wanted);
        return L"its entry point answered an error";
    }
    countAsLoaded(wanted);
    return {};
}

std::wstring RecordingLinker::unload(Application& loaded)
{
    if (!loaded.loaded)
        return L"it is not loaded";
    if (loaded.locked)
        return L"it is locked";
    if (!loaded.whyItDoesNotUnload.empty())
        return loaded.whyItDoesNotUnload;
    if (callEntryPoint(loaded.entryPoint, loaded.path, TSRX_MSG_UNLOAD, &loaded) != TSRX_RET_OK)
        return L"its entry point answered an error";
    forget(loaded);
    return {};
}

bool TsRxDynamicLinker::isKindOf(const wchar_t* className) const
{
    return className && std::wstring_view(className) == kClassName;
}
