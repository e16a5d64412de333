#include "host/files/HostInformation.h"

#include <algorithm>
#include <cwchar>
#include <string>
#include <string_view>

#include "host/text/CommandLine.h"
#include "host/text/Running.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"
#include "host/text/Version.h"

namespace tessel
{
const wchar_t* HostInformation::productRegistryRoot() const
{
    return kProductRegistryRoot;
}

const wchar_t* HostInformation::product() const
{
    return L"Tessel";
}

bool HostInformation::isUrl(const wchar_t* text) const
{
    constexpr std::wstring_view kSchemes[] = {L"http://", L"https://"};
    const std::wstring_view url = text ? text : L"";
    return std::any_of(std::begin(kSchemes), std::end(kSchemes),
                       [url](std::wstring_view scheme) {
                           return url.size() > scheme.size() &&
                                  equalIgnoringCase(url.substr(0, scheme.size()), scheme);
                       });
}

Result<RemoteFiles::Copy> HostInformation::fetch(const std::wstring& url, std::size_t capacity,
                                                 bool ignoreCache) const
{
    if (!isUrl(url.c_str()))
        return Failure{translated(L"\"{}\" is no http or https address.", url), TS_FETCH_FAILED};
    if (capacity == 0)
        return Failure{
            translated(L"{} could not be fetched: there is no room for the path of its local copy.", url),
            TS_FETCH_FAILED};
    return mRemote.fetch(url, capacity - 1, ignoreCache);
}

int HostInformation::fetchRemoteFile(const wchar_t* url, wchar_t* localPath, std::size_t capacity,
                                     bool ignoreCache)
{
    const auto copy = fetch(url ? url : L"", localPath ? capacity : 0, ignoreCache);
    if (!mCommandLine.tell(copy) || !localPath) // without room for the path it has failed
        return copy.code();
    std::wmemcpy(localPath, copy->path.c_str(), copy->path.size() + 1);
    return copy->status;
}
} // namespace tessel

TsDbHostApplicationServices* tsdbHostApplicationServices()
{
    return tessel::running<tessel::HostInformation>();
}
