// The host's record of an application: what it is called, where it is and when the host loads it by itself.
#pragma once

#include <memory>

#include "tsdefs.h"

// Load reasons, a sum of bits.
inline constexpr unsigned TSRX_LOAD_AT_HOST_START = 2;
inline constexpr unsigned TSRX_LOAD_ON_COMMAND = 4; // when one of its commands is typed and it is not loaded

inline constexpr int TSRX_APPINFO_OK = 0;
inline constexpr int TSRX_APPINFO_NOT_FOUND = 1;
inline constexpr int TSRX_APPINFO_ERROR = 2; // no name set or one with a backslash, or the registry refused

// One record, kept in memory until it is written. Strings are copied; those given back stay valid until the
// record changes or goes.
class TESSEL_API TesselAppInfo
{
public:
    TesselAppInfo();
    ~TesselAppInfo();
    TesselAppInfo(const TesselAppInfo&) = delete;
    TesselAppInfo& operator=(const TesselAppInfo&) = delete;

    // The name the record is filed under (case does not matter).
    void setAppName(const wchar_t* name);
    // The application's file: a full path, as `tsedGetAppName` gives it.
    void setModuleName(const wchar_t* path);
    void setDescription(const wchar_t* description);
    void setLoadReason(unsigned reasons);

    const wchar_t* appName() const;
    const wchar_t* moduleName() const;
    const wchar_t* description() const;
    unsigned loadReason() const;

    // Replaces everything but the name with what is stored under it. On failure nothing changes.
    int readFromRegistry();

    // Stores the record. `forAllUsers`: in the part of the registry that every user shares (a host without
    // one stores it for the current user). `withCommands`: also stores the names of the commands that the
    // calling application has registered by now; the host needs them for loading on command.
    int writeToRegistry(bool forAllUsers, bool withCommands);

private:
    struct Record;
    std::unique_ptr<Record> mRecord;
};
