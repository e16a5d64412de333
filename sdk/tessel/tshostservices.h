// The host application services: what the host is and where its things are.
#pragma once

#include "tsdefs.h"

class TESSEL_API TsDbHostApplicationServices
{
public:
    TsDbHostApplicationServices() = default;
    TsDbHostApplicationServices(const TsDbHostApplicationServices&) = delete;
    TsDbHostApplicationServices& operator=(const TsDbHostApplicationServices&) = delete;
    virtual ~TsDbHostApplicationServices() = default;

    // The key of the product below HKEY_CURRENT_USER, without backslashes at its ends:
    // "Software\\Tessel\\R21" for release 21. Valid as long as the host runs.
    virtual const wchar_t* productRegistryRoot() const = 0;

    // The folder in which the host keeps everything that lasts, as a full path; it exists. An application or
    // a toolkit that needs a place of its own makes a folder in it. Valid as long as the host runs.
    virtual const wchar_t* profileFolder() const = 0;

    // The product's name as a person reads it: "Tessel".
    virtual const wchar_t* product() const = 0;

    // Whether the text is a URL that `fetchRemoteFile` can fetch (http or https, case does not matter).
    virtual bool isUrl(const wchar_t* text) const = 0;

    // Makes a local copy of a remote file, of at most the host's size and within its time limit. Unless
    // `ignoreCache`, an earlier copy is taken. TS_FETCHED or TS_FROM_CACHE: `localPath` (capacity in
    // characters) holds the copy's full path. TS_FETCH_FAILED: nothing is left behind, and the reason
    // stands on the command line. The address may ask for a checksum (`#sha256=` and 64 hexadecimal
    // digits), and carry a name and a password, which are neither told nor stored.
    virtual int fetchRemoteFile(const wchar_t* url, wchar_t* localPath, std::size_t capacity,
                                bool ignoreCache) = 0;
};

// Null while the host starts or ends.
TESSEL_API TsDbHostApplicationServices* tsdbHostApplicationServices();
