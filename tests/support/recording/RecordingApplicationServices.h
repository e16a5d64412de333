// The host application services and the host's remote files, without a network.
#pragma once

#include <map>
#include <optional>
#include <string>
#include <vector>

#include <tessel/tshostservices.h>
#include <tessel/tsinet.h>

class RecordingApplicationServices : public TsDbHostApplicationServices
{
public:
    bool exist = true; // false: `tsdbHostApplicationServices` answers null

    std::wstring registryRoot = L"Software\\Tessel\\R21";
    std::wstring folderOfProfile = L"/recorded-profile"; // of no disk
    std::wstring productName = L"Tessel";

    struct Remote
    {
        int status = TS_FETCH_FAILED;
        std::wstring localPath;
    };
    // What fetching a URL answers (exact text); others fail. What was fetched (TS_FETCHED) is a file and a
    // known copy from then on, and is taken from the cache the next time.
    std::map<std::wstring, Remote> remotes;

    struct Fetch
    {
        std::wstring url;
        bool ignoreCache = false;

        bool operator==(const Fetch&) const = default;
    };
    // The fetches and the texts that `isUrl` was asked about, in order.
    std::vector<Fetch> fetches;
    mutable std::vector<std::wstring> askedForUrl;

    const wchar_t* productRegistryRoot() const override;
    const wchar_t* profileFolder() const override;
    const wchar_t* product() const override;
    bool isUrl(const wchar_t* text) const override; // http:// or https:// and something after it
    int fetchRemoteFile(const wchar_t* url, wchar_t* localPath, std::size_t capacity,
                        bool ignoreCache) override;

private:
    Remote answerTo(const std::wstring& url, bool ignoreCache) const;
};

class RecordingInternet : public CProxyInet
{
public:
    bool exists = true; // false: `GetProxyInet` answers null

    // The files that are copies of remote ones, and where they came from; what is fetched joins them.
    std::map<std::wstring, std::wstring> urlsOfLocalFiles;
    // The paths that were asked about, in order.
    mutable std::vector<std::wstring> asked;
    // The room that each caller had for the URL, in characters.
    mutable std::vector<std::size_t> rooms;

    bool IsRemoteFile(const wchar_t* localPath, wchar_t* url, std::size_t capacity) const override;

    // The local copy of a URL, if there is one.
    std::optional<std::wstring> copyOf(const std::wstring& url) const;
};
