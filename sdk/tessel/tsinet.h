// Which local files are copies of remote ones.
#pragma once

#include "tsdefs.h"

class TESSEL_API CProxyInet
{
public:
    CProxyInet() = default;
    CProxyInet(const CProxyInet&) = delete;
    CProxyInet& operator=(const CProxyInet&) = delete;
    virtual ~CProxyInet() = default;

    static CProxyInet* GetProxyInet();

    // Whether the file at the path is a local copy that the host made of a remote file; `url` (capacity in
    // characters) then holds where it came from, cut if it does not fit.
    virtual bool IsRemoteFile(const wchar_t* localPath, wchar_t* url, std::size_t capacity) const = 0;
};
