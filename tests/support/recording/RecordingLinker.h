// The dynamic linker without libraries: applications are paths, their entry points are functions of the test.
//
// Untold, every path loads and unloads. Paths compare letter by letter. What is loaded here, by a call or by
// a test, is also what `tsedQmbLoaded` reports (see RecordingLoadedModules.h), under its file name.
#pragma once

#include <functional>
#include <map>
#include <string>
#include <vector>

#include <tessel/tsrxlinker.h>

class RecordingLinker : public TsRxDynamicLinker
{
public:
    using EntryPoint = std::function<int(unsigned message, void* application)>;

    struct Call
    {
        enum class Operation
        {
            kLoad,
            kUnload,
            kIsLocked
        };
        Operation operation = Operation::kLoad;
        std::wstring path;
        bool sayWhyNot = false;
        bool resolveNow = false;
    };

    // The application is loaded, without its entry point being called.
    void setLoaded(const std::wstring& path);
    // Loads the application, if need be as `setLoaded` does, and locks it or not.
    void setLocked(const std::wstring& path, bool locked = true);
    // From now on the path does not load (or unload), for this reason, until `allow`.
    void refuseToLoad(const std::wstring& path, const std::wstring& reason = L"there is no such file");
    void refuseToUnload(const std::wstring& path, const std::wstring& reason = L"it will not go");
    void allow(const std::wstring& path);
    // From now on an unload takes the path out of service, and says that its code stays in memory.
    void keepMapped(const std::wstring& path);
    // From now on only paths that were given an entry point load; of the others there is no such file.
    void loadOnlyKnown() { mLoadsAnything = false; }
    // Called with message 1 during a load and message 2 during an unload, as a real entry point is; while it
    // runs, `tsedGetAppName` answers the path. It may lock its path, load others, or print.
    void setEntryPoint(const std::wstring& path, EntryPoint entryPoint);

    bool isLoaded(const std::wstring& path) const;
    // The handle that the path's entry point gets; made when it is new.
    void* handleOf(const std::wstring& path);

    std::vector<Call> calls;              // in order, failed ones included
    std::vector<void*> registeredHandles; // every handle given to `registerApplication`, known or not

    bool registerApplication(void* application) override;
    bool loadModule(const wchar_t* path, bool sayWhyNot, bool resolveNow) override;
    bool unloadModule(const wchar_t* path, bool sayWhyNot) override;
    bool isModuleLocked(const wchar_t* path) const override;
    bool setApplicationLocked(void* application, bool locked) override;

private:
    struct Application
    {
        std::wstring path;
        EntryPoint entryPoint;
        std::wstring whyItDoesNotLoad;
        std::wstring whyItDoesNotUnload;
        bool loading = false; // its load message is running
        bool loaded = false;
        bool locked = false;
        bool staysMapped = false;
    };

    Application& application(const std::wstring& path);
    const Application* find(const std::wstring& path) const;
    Application* find(const void* handle);
    void countAsLoaded(Application& application);
    void forget(Application& application);
    std::wstring load(Application& application);
    std::wstring unload(Application& application);

    std::map<std::wstring, Application> mApplications;
    bool mLoadsAnything = true;
};
