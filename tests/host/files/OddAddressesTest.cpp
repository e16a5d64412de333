// Addresses as people and programs write them.
#include <gmock/gmock.h>

#include <ostream>

#include <tessel/tsdefs.h>

#include "tests/host/files/CaseName.h"
#include "tests/host/files/RemoteHost.h"
#include "tests/support/HttpServer.h"

namespace fs = std::filesystem;

using testing::AllOf;
using testing::EndsWith;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::StartsWith;

namespace
{
struct OddAddressCase
{
    const wchar_t* target;
    const char* fileName; // of the local copy
};

void PrintTo(const OddAddressCase& value, std::ostream* stream)
{
    *stream << tessel::toUtf8(value.target);
}

class OddAddress : public testing::TestWithParam<OddAddressCase>
{
};

// A copy stands two folders below the test's, under its own name, and nowhere else.
void expectInside(const RemoteHost& host, const std::wstring& copy, const std::string& name)
{
    const fs::path path = tessel::toUtf8(copy);
    EXPECT_EQ(path.filename(), name);
    EXPECT_EQ(path.parent_path().parent_path(), host.cache());
    EXPECT_TRUE(fs::is_regular_file(path));
    EXPECT_EQ(host.stored().size(), 3u) << "its folder, the copy and its origin";
}
} // namespace

TEST_P(OddAddress, HasACopyInsideOfTheCache)
{
    const HttpServer server(
        [](const std::string&) {
            return HttpServer::Answer{httpAnswer("200 OK", "1"), "", {}};
        });
    RemoteHost host;
    const std::wstring url = server.url(GetParam().target);
    const auto copy = host.fetch(url);
    ASSERT_EQ(copy.status, TS_FETCHED) << host.output().text();
    expectInside(host, copy.path, GetParam().fileName);
    wchar_t origin[1024] = {};
    EXPECT_TRUE(host.remote().IsRemoteFile(copy.path.c_str(), origin, 1024));
    EXPECT_EQ(origin, url);
    EXPECT_EQ(host.fetch(url).status, TS_FROM_CACHE);
    EXPECT_EQ(host.output().text(), "");
}

INSTANTIATE_TEST_SUITE_P(
    Table, OddAddress,
    testing::Values(
        OddAddressCase{L"", "download"}, OddAddressCase{L"/", "download"},
        OddAddressCase{L"/a/b/", "download"}, OddAddressCase{L"/tool.lsp?x=1&y=/z.txt", "tool.lsp"},
        OddAddressCase{L"/tool.lsp#part", "tool.lsp"}, OddAddressCase{L"?file=/tool.lsp", "download"},
        OddAddressCase{L"/my%20tool.lsp", "my%20tool.lsp"},
        OddAddressCase{L"/%2e%2e%2f%2e%2e%2fetc%2fpasswd", "%2e%2e%2f%2e%2e%2fetc%2fpasswd"},
        OddAddressCase{L"/..", "download"}, OddAddressCase{L"/a/../../tool.lsp", "tool.lsp"},
        OddAddressCase{L"/.", "download"}, OddAddressCase{L"/.url", "download"},
        OddAddressCase{L"/..\\..\\tool.lsp", ".._.._tool.lsp"},
        OddAddressCase{L"/100%25s%25n.lsp", "100%25s%25n.lsp"}, OddAddressCase{L"/größe.lsp", "größe.lsp"},
        OddAddressCase{L"//tool.lsp", "tool.lsp"}, OddAddressCase{L"/tool.lsp;v=1", "tool.lsp;v=1"}),
    [](const auto& which) { return caseName(which.index, which.param.target); });

TEST(LongAddress, KeepsTheEndOfItsNameWhichTellsTheKind)
{
    const HttpServer server(
        [](const std::string&) {
            return HttpServer::Answer{httpAnswer("200 OK", "1"), "", {}};
        });
    RemoteHost host;
    const std::wstring url = server.url(L"/" + std::wstring(3000, L'ü') + L"x.lsp");
    const auto copy = host.fetch(url);
    ASSERT_EQ(copy.status, TS_FETCHED) << host.output().text();
    std::string name;
    for (int i = 0; i < 97; ++i)
        name += "ü";
    expectInside(host, copy.path, name + "x.lsp");
    EXPECT_TRUE(host.remote().IsRemoteFile(copy.path.c_str(), nullptr, 0));
    EXPECT_EQ(host.fetch(url).status, TS_FROM_CACHE);
}

TEST(LongAddress, ThatNoServerTakesIsAFailure)
{
    RemoteHost host;
    const std::wstring url = L"http://" + std::wstring(100'000, L'x') + L"/tool.lsp";
    EXPECT_EQ(host.fetch(url).status, TS_FETCH_FAILED);
    EXPECT_THAT(host.output().text(), HasSubstr(" could not be fetched: "));
    EXPECT_THAT(host.stored(), IsEmpty());
}

TEST(BadAddress, IsAFailureWithASentence)
{
    for (const wchar_t* url :
         {L"http://127.0.0.1:99999/tool.lsp", L"http://:80/tool.lsp", L"http://a b/tool.lsp",
          L"http://[::1/tool.lsp", L"http:///", L"http://127.0.0.1:x/"})
    {
        RemoteHost host;
        EXPECT_EQ(host.fetch(url).status, TS_FETCH_FAILED) << url;
        EXPECT_THAT(host.output().text(),
                    AllOf(StartsWith(tessel::toUtf8(url) + " could not be fetched: "), EndsWith(".\n")));
        EXPECT_THAT(host.stored(), IsEmpty());
    }
}
