// The service "DynamicLinker": loads and unloads compiled applications.
#pragma once

#include "tsrx.h"

class TESSEL_API TsRxDynamicLinker : public TsRxObject
{
public:
    static constexpr const wchar_t* kClassName = L"TsRxDynamicLinker";

    // The object as a dynamic linker, or null when it is none (null included).
    static TsRxDynamicLinker* cast(TsRxObject* object)
    {
        return object && object->isKindOf(kClassName) ? static_cast<TsRxDynamicLinker*>(object) : nullptr;
    }

    // Declares the application in service while its entry point is still at work: from now on it counts as
    // loaded, so that a request for it from what it loads itself is not a second load. Without the call it
    // counts as loaded once its entry point has answered success. Answers false for an unknown handle.
    virtual bool registerApplication(void* application) = 0;

    // Loads the file at the full path and sends it message 1: a `.bundle` folder as the platform loads its
    // bundles, anything else as a shared library. `sayWhyNot`: a failure is explained in one line on the
    // command line, with the path and the system linker's own words. `resolveNow`: every symbol must resolve
    // before the entry point runs; false leaves functions to be resolved at their first call. A file that is
    // loaded already answers true and nothing happens.
    virtual bool loadModule(const wchar_t* path, bool sayWhyNot, bool resolveNow) = 0;

    // Sends message 2 to the application loaded from the path and takes it out of the process. False, with a
    // line on the command line when `sayWhyNot`, if it is not loaded, is locked, or answers an error. Where
    // the system keeps the library mapped (one that brings Objective-C classes, for instance), the
    // application is out of service and its commands are gone, which is true as well: the line then says that
    // its code stays in memory. A later load sends message 1 to that code, whatever the file holds by then.
    virtual bool unloadModule(const wchar_t* path, bool sayWhyNot) = 0;

    // Whether the application loaded from the path may not be unloaded. False for a path that is not loaded.
    virtual bool isModuleLocked(const wchar_t* path) const = 0;

    // An application forbids or allows its own unloading, with the handle of its entry point. False for an
    // unknown handle.
    virtual bool setApplicationLocked(void* application, bool locked) = 0;

    bool isKindOf(const wchar_t* className) const override;
};
