#include <tessel/tshostservices.h>
#include <tessel/tsinet.h>
#include <wincompat/winfile.h>

#include "tests/contract/ContractTest.h"

namespace
{
constexpr const wchar_t* kUntouched = L"untouched";

class InternetContract : public ContractTest
{
protected:
    static TsDbHostApplicationServices& services() { return *tsdbHostApplicationServices(); }

    struct Fetched
    {
        int status = 0;
        std::wstring path; // what the buffer holds then
    };
    static Fetched fetch(const std::wstring& url, bool ignoreCache = false, std::size_t capacity = kPathSize)
    {
        wchar_t path[kPathSize] = {};
        std::wcscpy(path, kUntouched);
        const int status = services().fetchRemoteFile(url.c_str(), path, capacity, ignoreCache);
        return {status, path};
    }

    static bool isRemote(const std::wstring& path)
    {
        wchar_t url[kPathSize] = {};
        return CProxyInet::GetProxyInet()->IsRemoteFile(path.c_str(), url, kPathSize);
    }

    // Where a local copy came from, as far as it fits.
    static std::wstring originOf(const std::wstring& path, std::size_t capacity = kPathSize)
    {
        wchar_t url[kPathSize] = {};
        EXPECT_TRUE(CProxyInet::GetProxyInet()->IsRemoteFile(path.c_str(), url, capacity));
        return url;
    }

    static bool isFile(const std::wstring& path)
    {
        const DWORD attributes = GetFileAttributesW(path.c_str());
        return attributes != INVALID_FILE_ATTRIBUTES && (attributes & FILE_ATTRIBUTE_DIRECTORY) == 0;
    }

    // A failure touches no buffer and says why.
    void expectFailure(const Fetched& fetched, const std::wstring& url) const
    {
        EXPECT_EQ(fetched.status, TS_FETCH_FAILED);
        EXPECT_EQ(fetched.path, kUntouched);
        EXPECT_TRUE(contains(host->seen(), url)) << testing::PrintToString(host->seen());
    }
};

TEST_F(InternetContract, KnowsAUrlThatItCanFetch)
{
    for (const wchar_t* url :
         {L"http://example.test/tool.lsp", L"https://example.test", L"HTTPS://Example.Test/"})
        EXPECT_TRUE(services().isUrl(url));
    for (const wchar_t* text :
         {L"", L"/a/tool.lsp", L"tool.lsp", L"http:", L"http://", L"ftp://example.test/tool.lsp",
          L"file:///a/tool.lsp", L"C:\\a\\tool.lsp", L" http://example.test/"})
        EXPECT_FALSE(services().isUrl(text)) << testing::PrintToString(text);
    EXPECT_FALSE(services().isUrl(nullptr));
}

TEST_F(InternetContract, FetchesAFileToThePathItAnswers)
{
    const auto [status, path] = fetch(host->serve(L"tool.lsp"));
    EXPECT_EQ(status, 20000);
    EXPECT_TRUE(path.starts_with(L"/")) << testing::PrintToString(path);
    EXPECT_TRUE(isFile(path)) << testing::PrintToString(path);
}

TEST_F(InternetContract, TakesTheEarlierCopyOfWhatItHasFetched)
{
    const std::wstring url = host->serve(L"tool.lsp");
    const std::wstring path = fetch(url).path;
    host->stopServing(L"tool.lsp"); // nobody is asked
    const Fetched again = fetch(url);
    EXPECT_EQ(again.status, 20001);
    EXPECT_EQ(again.path, path);
    EXPECT_TRUE(isFile(path));
}

TEST_F(InternetContract, FetchesAgainWhenToldToIgnoreTheCache)
{
    const std::wstring url = host->serve(L"tool.lsp");
    const std::wstring path = fetch(url).path;
    const Fetched again = fetch(url, true);
    EXPECT_EQ(again.status, 20000);
    EXPECT_EQ(again.path, path);
    host->stopServing(L"tool.lsp");
    expectFailure(fetch(url, true), url);
}

TEST_F(InternetContract, KeepsTheCopiesOfTwoUrlsApart)
{
    const std::wstring one = host->serve(L"one/tool.lsp");
    const std::wstring two = host->serve(L"two/tool.lsp");
    const Fetched first = fetch(one);
    const Fetched second = fetch(two);
    EXPECT_EQ(second.status, TS_FETCHED);
    EXPECT_NE(second.path, first.path);
    EXPECT_EQ(originOf(first.path), one);
    EXPECT_EQ(originOf(second.path), two);
}

TEST_F(InternetContract, SaysWhyAUrlCannotBeFetched)
{
    // Nobody listens at the discard port of this machine.
    const std::wstring url = L"http://127.0.0.1:9/tool.lsp";
    expectFailure(fetch(url), url);
}

TEST_F(InternetContract, LeavesNothingOfAFailedFetchBehind)
{
    const std::wstring url = host->serve(L"tool.lsp");
    host->stopServing(L"tool.lsp");
    expectFailure(fetch(url), url);
    host->serve(L"tool.lsp");
    EXPECT_EQ(fetch(url).status, TS_FETCHED);
}

TEST_F(InternetContract, FetchesNothingButHttp)
{
    const std::wstring file = host->makeFile(L"tool.lsp");
    for (const std::wstring& text : {file, L"file://" + file, L"ftp://example.test" + file})
        expectFailure(fetch(text), text);
    EXPECT_EQ(services().fetchRemoteFile(nullptr, std::vector<wchar_t>(kPathSize).data(), kPathSize, false),
              TS_FETCH_FAILED);
}

TEST_F(InternetContract, FailsWithoutRoomForThePathAndLeavesNothingBehind)
{
    const std::wstring url = host->serve(L"tool.lsp");
    expectFailure(fetch(url, false, 4), url);
    EXPECT_EQ(fetch(url).status, TS_FETCHED);
}

TEST_F(InternetContract, CountsTheTerminatorAsPartOfThePath)
{
    const std::wstring url = host->serve(L"tool.lsp");
    const std::wstring path = fetch(url).path;
    expectFailure(fetch(url, false, path.size()), url);
    const Fetched fitting = fetch(url, false, path.size() + 1);
    EXPECT_EQ(fitting.status, TS_FROM_CACHE);
    EXPECT_EQ(fitting.path, path);
}

TEST_F(InternetContract, SaysWhyItFailsWithoutABufferToo)
{
    const std::wstring url = host->serve(L"tool.lsp");
    expectFailure(fetch(url, false, 0), url);
    const std::wstring other = host->serve(L"other.lsp");
    EXPECT_EQ(services().fetchRemoteFile(other.c_str(), nullptr, kPathSize, false), TS_FETCH_FAILED);
    EXPECT_TRUE(contains(host->seen(), other));
    EXPECT_EQ(fetch(other).status, TS_FETCHED);
}

TEST_F(InternetContract, KnowsWhereALocalCopyCameFrom)
{
    const std::wstring url = host->serve(L"tool.lsp");
    EXPECT_EQ(originOf(fetch(url).path), url);
    EXPECT_EQ(originOf(fetch(url).path), url); // taken from the cache
}

TEST_F(InternetContract, CutsAUrlThatDoesNotFit)
{
    const std::wstring url = host->serve(L"tool.lsp");
    const std::wstring path = fetch(url).path;
    EXPECT_EQ(originOf(path, url.size() + 1), url);
    EXPECT_EQ(originOf(path, url.size()), url.substr(0, url.size() - 1));
    EXPECT_EQ(originOf(path, 5), url.substr(0, 4));
    EXPECT_EQ(originOf(path, 1), L"");
    EXPECT_EQ(originOf(path, 0), L"");
    EXPECT_TRUE(CProxyInet::GetProxyInet()->IsRemoteFile(path.c_str(), nullptr, kPathSize));
}

TEST_F(InternetContract, TouchesNothingAfterTheUrl)
{
    const std::wstring path = fetch(host->serve(L"tool.lsp")).path;
    wchar_t url[8] = L"???????";
    EXPECT_TRUE(CProxyInet::GetProxyInet()->IsRemoteFile(path.c_str(), url, 5));
    EXPECT_STREQ(url, L"http");
    EXPECT_EQ(url[5], L'?');
    EXPECT_TRUE(CProxyInet::GetProxyInet()->IsRemoteFile(path.c_str(), url, 0));
    EXPECT_STREQ(url, L"http");
}

TEST_F(InternetContract, TakesAnOrdinaryFileForNoRemoteFile)
{
    fetch(host->serve(L"tool.lsp")); // there is a copy of the same name
    EXPECT_FALSE(isRemote(host->makeFile(L"tool.lsp")));
    EXPECT_FALSE(isRemote(L"/none/tool.lsp"));
    EXPECT_FALSE(isRemote(L""));
    EXPECT_FALSE(CProxyInet::GetProxyInet()->IsRemoteFile(nullptr, nullptr, 0));
}

TEST_F(InternetContract, TakesTheFolderOfACopyForNoRemoteFile)
{
    const std::wstring path = fetch(host->serve(L"tool.lsp")).path;
    EXPECT_FALSE(isRemote(path.substr(0, path.rfind(L'/'))));
}
} // namespace
