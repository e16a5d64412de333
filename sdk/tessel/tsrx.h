// The host's registry of named services, and the contract of an application's entry point.
#pragma once

#include "tsdefs.h"

// Every service of the host. A service is found by name and cast with its own `cast`, which answers null for
// an object of another class, so that a wrong name is an error and never a wild call.
class TESSEL_API TsRxObject
{
public:
    TsRxObject() = default;
    TsRxObject(const TsRxObject&) = delete;
    TsRxObject& operator=(const TsRxObject&) = delete;
    virtual ~TsRxObject() = default;

    // Whether the object is of the class of that name, or of one derived from it.
    virtual bool isKindOf(const wchar_t* className) const = 0;
};

// The named services. The host owns every object and keeps it until it ends; nothing is freed by the caller.
class TESSEL_API TsRxSysRegistry
{
public:
    TsRxSysRegistry() = default;
    TsRxSysRegistry(const TsRxSysRegistry&) = delete;
    TsRxSysRegistry& operator=(const TsRxSysRegistry&) = delete;
    virtual ~TsRxSysRegistry() = default;

    // The object registered under the name (case matters), or null.
    virtual TsRxObject* at(const wchar_t* name) const = 0;
};

TESSEL_API TsRxSysRegistry* tsrxSysRegistry();

// Names of the services in the system registry.
inline constexpr const wchar_t* TSRX_DYNAMIC_LINKER = L"DynamicLinker";
inline constexpr const wchar_t* TSED_REGISTERED_COMMANDS = L"TESSEL_REGISTERED_COMMANDS";
inline constexpr const wchar_t* TSRX_KEPT_OUT = L"KeptOutApplications";

// What an application exports: `extern "C" TESSEL_EXPORT int tsrxEntryPoint(unsigned message, void*
// application)`. `application` is the host's handle of the application, valid until the application is
// unloaded.
inline constexpr unsigned TSRX_MSG_LOAD = 1;   // set yourself up; an error answer makes the load fail
inline constexpr unsigned TSRX_MSG_UNLOAD = 2; // give everything back; an error answer keeps the application
inline constexpr int TSRX_RET_OK = 0;
inline constexpr int TSRX_RET_ERROR = 3;

using TsRxEntryPoint = int (*)(unsigned message, void* application);
