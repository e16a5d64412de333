#include "host/files/HostInformation.h"

#include <gmock/gmock.h>

#include "tests/host/files/RemoteHost.h"
#include "tests/support/HttpServer.h"

using testing::HasSubstr;
using testing::IsEmpty;

namespace
{
constexpr std::size_t kRoomForPath = 1024;

class HostInformation : public testing::Test
{
protected:
    RemoteHost host;
    tessel::HostInformation information{L"/profile", host.remote(), host.output().commandLine()};
    HttpServer server{[](const std::string&)
                      {
                          return HttpServer::Answer{httpAnswer("200 OK", "1"), "", {}};
                      }};
};
} // namespace

TEST_F(HostInformation, TellWhatTheHostIs)
{
    EXPECT_STREQ(information.productRegistryRoot(), L"Software\\Tessel\\R21");
    EXPECT_STREQ(information.product(), L"Tessel");
    EXPECT_STREQ(information.profileFolder(), L"/profile");
    EXPECT_EQ(tsdbHostApplicationServices(), nullptr);
    const tessel::Published<tessel::HostInformation> published(information);
    EXPECT_EQ(tsdbHostApplicationServices(), &information);
}

TEST_F(HostInformation, TakeHttpAndHttpsForAddresses)
{
    for (const wchar_t* url : {L"http://x", L"https://x/tool.lsp", L"HTTP://X", L"HttpS://x"})
        EXPECT_TRUE(information.isUrl(url)) << url;
    for (const wchar_t* text : {L"", L"http://", L"https://", L"http:/x", L"ftp://x", L"file:///x",
                                L"/http://x", L" http://x", L"tool.lsp", L"C:\\tool.lsp", L"httpx://x"})
        EXPECT_FALSE(information.isUrl(text)) << text;
    EXPECT_FALSE(information.isUrl(nullptr));
}

TEST_F(HostInformation, FetchThenTakeFromTheCacheUnlessToldOtherwise)
{
    const std::wstring url = server.url(L"/tool.lsp");
    wchar_t path[kRoomForPath] = {};
    EXPECT_EQ(information.fetchRemoteFile(url.c_str(), path, kRoomForPath, false), TS_FETCHED);
    EXPECT_EQ(host.content(std::wstring(path)), "1");
    EXPECT_EQ(information.fetchRemoteFile(url.c_str(), path, kRoomForPath, false), TS_FROM_CACHE);
    EXPECT_EQ(information.fetchRemoteFile(url.c_str(), path, kRoomForPath, true), TS_FETCHED);
    EXPECT_EQ(server.requests().size(), 2u);
}

TEST_F(HostInformation, LeaveNothingBehindWhenThePathDoesNotFit)
{
    const std::wstring url = server.url(L"/tool.lsp");
    wchar_t path[kRoomForPath] = L"untouched";
    EXPECT_EQ(information.fetchRemoteFile(url.c_str(), path, 20, false), TS_FETCH_FAILED);
    EXPECT_STREQ(path, L"untouched");
    EXPECT_THAT(host.stored(), IsEmpty());
    EXPECT_THAT(host.output().text(), HasSubstr("the path of its local copy has more than 19 characters"));
}

TEST_F(HostInformation, RefuseWhatIsNoAddressWithASentence)
{
    wchar_t path[kRoomForPath] = L"untouched";
    EXPECT_EQ(information.fetchRemoteFile(L"file:///etc/passwd", path, kRoomForPath, false), TS_FETCH_FAILED);
    EXPECT_EQ(host.output().text(), "\"file:///etc/passwd\" is no http or https address.\n");
    EXPECT_EQ(information.fetchRemoteFile(nullptr, path, kRoomForPath, false), TS_FETCH_FAILED);
    EXPECT_STREQ(path, L"untouched");
    EXPECT_THAT(host.stored(), IsEmpty());
}

TEST_F(HostInformation, SayThatThereIsNoRoomForThePathAtAll)
{
    const std::string sentence =
        "http://x could not be fetched: there is no room for the path of its local copy.\n";
    wchar_t path[kRoomForPath] = L"untouched";
    EXPECT_EQ(information.fetchRemoteFile(L"http://x", nullptr, kRoomForPath, false), TS_FETCH_FAILED);
    EXPECT_EQ(host.output().text(), sentence);
    EXPECT_EQ(information.fetchRemoteFile(L"http://x", path, 0, false), TS_FETCH_FAILED);
    EXPECT_EQ(host.output().text(), sentence + sentence);
    EXPECT_STREQ(path, L"untouched");
    EXPECT_THAT(host.stored(), IsEmpty());
}
