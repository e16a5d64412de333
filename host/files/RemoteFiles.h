// Remote files: fetched over http and https into a cache that remembers where each local copy came from.
#pragma once

#include <tessel/tsinet.h>

#include <chrono>
#include <cstdint>
#include <filesystem>
#include <functional>
#include <string>

#include "host/text/Result.h"

namespace tessel
{
class Interruption;
struct RemoteAddress;

class RemoteFiles : public CProxyInet
{
public:
    using Say = std::function<void(const std::wstring& sentence)>;

    struct Limits
    {
        std::uint64_t bytes = 64u << 20;
        std::chrono::milliseconds connecting{10'000};
        std::chrono::milliseconds whole{60'000};
    };

    struct Copy
    {
        int status;        // TS_FETCHED or TS_FROM_CACHE
        std::wstring path; // of the local copy
    };

    // The cache folder is made with the first copy; what a killed download has left in it goes now.
    // `say` tells a person who waits how far a download has come.
    RemoteFiles(std::filesystem::path cacheFolder, Limits limits, Interruption& interruption, Say say = {});

    // Makes a local copy, or, unless `ignoreCache`, takes an earlier one that nobody else could have written.
    // The address may carry a name and a password, which are sent to its server, and neither stored nor told:
    // such a file is fetched each time. It may ask for a checksum (`#sha256=`): no other file is kept. A
    // failure, which a path longer than `longestPath` characters is too, leaves nothing new behind and has
    // the code TS_FETCH_FAILED.
    Result<Copy> fetch(const std::wstring& url, std::size_t longestPath, bool ignoreCache);

    bool IsRemoteFile(const wchar_t* localPath, wchar_t* url, std::size_t capacity) const override;

private:
    std::filesystem::path copyOf(const std::string& url) const;
    bool hasCopy(const std::filesystem::path& copy, const RemoteAddress& address) const;
    bool canBeTrusted(const std::filesystem::path& copy) const;
    Result<> fetchInto(const std::filesystem::path& copy, const RemoteAddress& address) const;

    std::filesystem::path mCacheFolder;
    Limits mLimits;
    Interruption& mInterruption;
    Say mSay;
};
} // namespace tessel
