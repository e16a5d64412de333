#include "tests/support/recording/RecordingApplicationServices.h"

#include <algorithm>
#include <cwchar>

#include "host/text/Unicode.h"
#include "tests/support/RecordingHost.h"

const wchar_t* RecordingApplicationServices::productRegistryRoot() const
{
    return registryRoot.c_str();
}

const wchar_t* RecordingApplicationServices::product() const
{
    return productName.c_str();
}

bool RecordingApplicationServices::isUrl(const wchar_t* text) const
{
    recordingHost().journal.add(L"isUrl", {text});
    askedForUrl.emplace_back(text);
    const std::wstring folded = tessel::foldCase(text);
    for (const std::wstring_view scheme : {L"http://", L"https://"})
        if (folded.starts_with(scheme) && folded.size() > scheme.size())
            return true;
    return false;
}

int RecordingApplicationServices::fetchRemoteFile(const wchar_t* url, wchar_t* localPath,
                                                  std::size_t capacity, bool ignoreCache)
{
    recordingHost().journal.add(L"fetchRemoteFile", {url, ignoreCache});
    fetches.push_back({url, ignoreCache});
    const auto remote = remotes.find(url);
    if (remote != remotes.end() && remote->second.status != TS_FETCH_FAILED &&
        copyText(remote->second.localPath, localPath, capacity))
        return remote->second.status;
    recordingHost().output.say(std::wstring(L"Cannot fetch ") + url + L".");
    return remote == remotes.end() ? TS_FETCH_FAILED : remote->second.status;
}

bool RecordingInternet::IsRemoteFile(const wchar_t* localPath, wchar_t* url, std::size_t capacity) const
{
    recordingHost().journal.add(L"IsRemoteFile", {localPath});
    asked.emplace_back(localPath);
    const auto remote = urlsOfLocalFiles.find(localPath);
    if (remote == urlsOfLocalFiles.end())
        return false;
    copyText(remote->second.substr(0, capacity == 0 ? 0 : capacity - 1), url, capacity);
    return true;
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
