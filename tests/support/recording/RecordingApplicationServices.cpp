#include "tests/support/recording/RecordingApplicationServices.h"

#include <algorithm>
#include <cwchar>

#include "host/text/Unicode.h"
#include "tests/support/RecordingHost.h"

const wchar_t* RecordingApplicationServices::productRegistryRoot() const
{
    return registryRoot.c_str();
}

const wchar_t* RecordingApplicationServices::profileFolder() const
{
    return folderOfProfile.c_str();
}

const wchar_t* RecordingApplicationServices::product() const
{
    return productName.c_str();
}

bool RecordingApplicationServices::isUrl(const wchar_t* text) const
{
    recordingHost().journal.add(L"isUrl", {text});
    askedForUrl.push_back(orEmpty(text));
    const std::wstring folded = tessel::foldCase(askedForUrl.back());
    for (const std::wstring_view scheme : {L"http://", L"https://"})
        if (folded.starts_with(scheme) && folded.size() > scheme.size())
            return true;
    return false;
}

int RecordingApplicationServices::fetchRemoteFile(const wchar_t* url, wchar_t* localPath,
                                                  std::size_t capacity, bool ignoreCache)
{
    RecordingHost& host = recordingHost();
    host.journal.add(L"fetchRemoteFile", {url, ignoreCache});
    const std::wstring address = orEmpty(url);
    fetches.push_back({address, ignoreCache});
    const Remote remote = answerTo(address, ignoreCache);
    if (remote.status == TS_FETCH_FAILED || !copyText(remote.localPath, localPath, capacity))
    {
        host.output.say(L"Cannot fetch " + address + L".");
        return TS_FETCH_FAILED;
    }
    if (remote.status == TS_FETCHED)
    {
        host.files.addFile(remote.localPath);
        host.internet.urlsOfLocalFiles[remote.localPath] = address;
    }
    return remote.status;
}

RecordingApplicationServices::Remote RecordingApplicationServices::answerTo(const std::wstring& url,
                                                                            bool ignoreCache) const
{
    if (const auto copy = recordingHost().internet.copyOf(url); copy && !ignoreCache)
        return {TS_FROM_CACHE, *copy};
    const auto told = remotes.find(url);
    return told == remotes.end() ? Remote() : told->second;
}

bool RecordingInternet::IsRemoteFile(const wchar_t* localPath, wchar_t* url, std::size_t capacity) const
{
    recordingHost().journal.add(L"IsRemoteFile", {localPath});
    asked.push_back(orEmpty(localPath));
    rooms.push_back(capacity);
    const auto remote = urlsOfLocalFiles.find(asked.back());
    if (remote == urlsOfLocalFiles.end())
        return false;
    copyText(remote->second.substr(0, capacity == 0 ? 0 : capacity - 1), url, capacity);
    return true;
}

std::optional<std::wstring> RecordingInternet::copyOf(const std::wstring& url) const
{
    for (const auto& [localPath, origin] : urlsOfLocalFiles)
        if (origin == url)
            return localPath;
    return std::nullopt;
}

TsDbHostApplicationServices* tsdbHostApplicationServices()
{
    RecordingHost& host = recordingHost();
    host.journal.add(L"tsdbHostApplicationServices");
    return host.applicationServices.exist ? &host.applicationServices : nullptr;
}

CProxyInet* CProxyInet::GetProxyInet()
{
    return recordingHost().internet.exists ? &recordingHost().internet : nullptr;
}
