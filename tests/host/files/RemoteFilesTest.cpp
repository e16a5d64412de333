#include "host/files/RemoteFiles.h"

#include <gmock/gmock.h>

#include <csignal>
#include <map>

#include <sys/resource.h>
#include <unistd.h>

#include <tessel/tsdefs.h>

#include "tests/host/files/RemoteHost.h"
#include "tests/support/HttpServer.h"

namespace fs = std::filesystem;

using testing::AllOf;
using testing::ElementsAre;
using testing::EndsWith;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
using testing::StartsWith;
using Copy = tessel::RemoteFiles::Copy;
using Then = HttpServer::Then;

namespace
{
std::string chunk(const std::string& bytes)
{
    char length[20];
    std::snprintf(length, sizeof length, "%zx\r\n", bytes.size());
    return length + bytes + "\r\n";
}

constexpr const char* kChunkedHead = "HTTP/1.1 200 OK\r\nTransfer-Encoding: chunked\r\n\r\n";
constexpr const char* kHeadOfMillion = "HTTP/1.1 200 OK\r\nContent-Length: 1000000\r\n\r\n";

class Remote : public testing::Test
{
protected:
    HttpServer::Answer answerTo(const std::string& target)
    {
        const auto found = answers.find(target);
        return found == answers.end()
                   ? HttpServer::Answer{httpAnswer("404 Not Found", "no such page"), "", {}}
                   : found->second;
    }
    void offer(const std::string& target, const std::string& bytes, Then then = Then::kClose,
               const std::string& repeat = "")
    {
        answers[target] = {bytes, repeat, then};
    }
    // One sentence with the URL and the reason, and in the cache what was there before.
    void expectFailure(tessel::RemoteFiles& files, const std::wstring& url, const std::string& reason,
                       bool ignoreCache = false)
    {
        const auto before = host.stored();
        host.output().clear();
        const Copy copy = host.told(files.fetch(url, RemoteHost::kLongestPath, ignoreCache));
        EXPECT_EQ(copy.status, TS_FETCH_FAILED);
        EXPECT_EQ(copy.path, L"");
        EXPECT_THAT(host.output().text(), AllOf(StartsWith(tessel::toUtf8(url) + " could not be fetched: "),
                                                HasSubstr(reason), EndsWith(".\n")));
        EXPECT_EQ(host.stored(), before);
    }
    void expectFailure(const std::string& target, const std::string& reason)
    {
        expectFailure(host.remote(), server.url(tessel::toWide(target)), reason);
    }

    std::map<std::string, HttpServer::Answer> answers; // changed only between requests
    HttpServer server{[this](const std::string& target)
                      {
                          return answerTo(target);
                      }};
    RemoteHost host;
};
} // namespace

TEST_F(Remote, AFileIsFetchedThenTakenFromTheCache)
{
    offer("/lisp/tool.lsp", httpAnswer("200 OK", "(princ)"));
    const Copy first = host.fetch(server.url(L"/lisp/tool.lsp"));
    EXPECT_EQ(first.status, TS_FETCHED);
    EXPECT_THAT(tessel::toUtf8(first.path), AllOf(StartsWith(host.cache().string()), EndsWith("/tool.lsp")));
    EXPECT_EQ(host.content(first.path), "(princ)");
    const Copy second = host.fetch(server.url(L"/lisp/tool.lsp"));
    EXPECT_EQ(second.status, TS_FROM_CACHE);
    EXPECT_EQ(second.path, first.path);
    EXPECT_THAT(server.requests(), ElementsAre("/lisp/tool.lsp"));
    EXPECT_EQ(host.output().text(), "");
}

TEST_F(Remote, TheCacheIsThereForTheNextSession)
{
    offer("/tool.lsp", httpAnswer("200 OK", "1"));
    EXPECT_EQ(host.fetch(server.url(L"/tool.lsp")).status, TS_FETCHED);
    tessel::RemoteFiles next = host.impatient();
    EXPECT_EQ(host.told(next.fetch(server.url(L"/tool.lsp"), RemoteHost::kLongestPath, false)).status,
              TS_FROM_CACHE);
}

TEST_F(Remote, TheCacheIsPassedOverOnRequest)
{
    offer("/tool.lsp", httpAnswer("200 OK", "old"));
    const Copy old = host.fetch(server.url(L"/tool.lsp"));
    offer("/tool.lsp", httpAnswer("200 OK", "new"));
    const Copy fresh = host.fetch(server.url(L"/tool.lsp"), true);
    EXPECT_EQ(fresh.status, TS_FETCHED);
    EXPECT_EQ(fresh.path, old.path);
    EXPECT_EQ(host.content(fresh.path), "new");
    EXPECT_EQ(host.fetch(server.url(L"/tool.lsp")).status, TS_FROM_CACHE);
}

TEST_F(Remote, ACopyThatIsGoneIsFetchedAgain)
{
    offer("/tool.lsp", httpAnswer("200 OK", "1"));
    const Copy copy = host.fetch(server.url(L"/tool.lsp"));
    fs::remove(tessel::toUtf8(copy.path));
    EXPECT_EQ(host.fetch(server.url(L"/tool.lsp")).status, TS_FETCHED);
}

TEST_F(Remote, FilesOfEveryContentComeWhole)
{
    std::string bytes;
    for (std::size_t i = 0; i < RemoteHost::kMostBytes; ++i)
        bytes += static_cast<char>(i * 7 % 256);
    offer("/large.bin", httpAnswer("200 OK", bytes));
    offer("/empty.bin", httpAnswer("200 OK", ""));
    offer("/chunked.bin", kChunkedHead + chunk(bytes.substr(0, 5)) + chunk(bytes.substr(5)) + chunk(""));
    offer("/untold.bin", "HTTP/1.0 200 OK\r\n\r\n" + bytes);
    EXPECT_TRUE(host.content(host.fetch(server.url(L"/large.bin")).path) == bytes);
    EXPECT_TRUE(host.content(host.fetch(server.url(L"/chunked.bin")).path) == bytes);
    EXPECT_TRUE(host.content(host.fetch(server.url(L"/untold.bin")).path) == bytes);
    const Copy empty = host.fetch(server.url(L"/empty.bin"));
    EXPECT_EQ(empty.status, TS_FETCHED);
    EXPECT_TRUE(fs::exists(tessel::toUtf8(empty.path)));
}

TEST_F(Remote, SameNamesFromDifferentPlacesAreKeptApart)
{
    offer("/a/tool.lsp", httpAnswer("200 OK", "a"));
    offer("/b/tool.lsp", httpAnswer("200 OK", "b"));
    const Copy first = host.fetch(server.url(L"/a/tool.lsp"));
    const Copy second = host.fetch(server.url(L"/b/tool.lsp"));
    EXPECT_EQ(host.content(first.path), "a");
    EXPECT_EQ(host.content(second.path), "b");
}

TEST_F(Remote, ALocalCopyTellsWhereItCameFrom)
{
    offer("/tool.lsp", httpAnswer("200 OK", "1"));
    const std::wstring url = server.url(L"/tool.lsp");
    const Copy copy = host.fetch(url);
    wchar_t origin[1024] = {};
    EXPECT_TRUE(host.remote().IsRemoteFile(copy.path.c_str(), origin, 1024));
    EXPECT_EQ(origin, url);
    wchar_t cut[6] = L"?????";
    EXPECT_TRUE(host.remote().IsRemoteFile(copy.path.c_str(), cut, 5));
    EXPECT_STREQ(cut, L"http");
    EXPECT_TRUE(host.remote().IsRemoteFile(copy.path.c_str(), nullptr, 0));
    EXPECT_EQ(CProxyInet::GetProxyInet(), &host.remote());
}

TEST_F(Remote, ALocalCopyIsKnownByEveryRoadToIt)
{
    offer("/tool.lsp", httpAnswer("200 OK", "1"));
    const fs::path copy = tessel::toUtf8(host.fetch(server.url(L"/tool.lsp")).path);
    fs::create_directory_symlink(host.cache(), host.folder() / "link");
    const fs::path roads[] = {host.folder() / "link" / copy.parent_path().filename() / "tool.lsp",
                              copy.parent_path() / ".." / copy.parent_path().filename() / "tool.lsp"};
    for (const fs::path& road : roads)
        EXPECT_TRUE(host.remote().IsRemoteFile(road.wstring().c_str(), nullptr, 0)) << road;
}

TEST_F(Remote, OtherFilesAreNotRemote)
{
    offer("/tool.lsp", httpAnswer("200 OK", "1"));
    const fs::path copy = tessel::toUtf8(host.fetch(server.url(L"/tool.lsp")).path);
    ASSERT_TRUE(fs::exists(copy));
    host.folder().write("tool.lsp", "");
    std::ofstream(copy.parent_path() / "beside.lsp") << "mine";
    std::ofstream(host.cache() / "mine.lsp") << "mine";
    fs::create_directory(host.cache() / "mine");
    std::ofstream(host.cache() / "mine" / "tool.lsp") << "mine";
    const fs::path others[] = {host.folder() / "tool.lsp",         copy.parent_path() / "beside.lsp",
                               host.cache() / "mine.lsp",          host.cache() / "mine" / "tool.lsp",
                               copy.parent_path() / ".url",        copy.parent_path(),
                               copy.parent_path() / "missing.lsp", ""};
    wchar_t origin[] = L"untouched";
    for (const fs::path& other : others)
        EXPECT_FALSE(host.remote().IsRemoteFile(other.wstring().c_str(), origin, 10)) << other;
    EXPECT_FALSE(host.remote().IsRemoteFile(nullptr, origin, 10));
    EXPECT_STREQ(origin, L"untouched");
}

TEST_F(Remote, AMissingFileIsAFailure)
{
    expectFailure("/missing.lsp", "404");
    EXPECT_THAT(host.stored(), IsEmpty());
}

TEST_F(Remote, AnAnswerWithoutTheFileIsAFailure)
{
    offer("/error", httpAnswer("500 Internal Server Error", "oops"));
    offer("/choices", httpAnswer("300 Multiple Choices", "choose"));
    offer("/unchanged", "HTTP/1.1 304 Not Modified\r\n\r\n");
    offer("/nothing", "HTTP/1.1 204 No Content\r\n\r\n");
    offer("/part", httpAnswer("206 Partial Content", "half", "Content-Range: bytes 0-3/8\r\n"));
    expectFailure("/error", "500");
    expectFailure("/choices", "the server answered 300");
    expectFailure("/unchanged", "the server answered 304");
    expectFailure("/nothing", "the server answered 204");
    expectFailure("/part", "the server answered 206");
}

TEST_F(Remote, AnAnswerThatIsNoHttpIsAFailure)
{
    offer("/silence", "");
    offer("/letter", "Dear Sir or Madam\n");
    expectFailure("/silence", "Empty reply from server");
    expectFailure("/letter", "HTTP/0.9");
}

TEST_F(Remote, ABodyThatIsCutShortIsAFailure)
{
    offer("/cut", "HTTP/1.1 200 OK\r\nContent-Length: 1000\r\n\r\nonly this");
    offer("/chunk", kChunkedHead + chunk("a chunk") + "ff\r\nnot all");
    offer("/no-end", kChunkedHead + chunk("a chunk"));
    expectFailure("/cut", "bytes remaining to read");
    expectFailure("/chunk", "transfer closed");
    expectFailure("/no-end", "transfer closed");
}

TEST_F(Remote, ABodyThatNeverEndsIsGivenUp)
{
    offer("/drip", "HTTP/1.1 200 OK\r\nContent-Length: 1000\r\n\r\na first piece", Then::kStall);
    auto impatient = host.impatient();
    expectFailure(impatient, server.url(L"/drip"), "timed out");
}

TEST_F(Remote, AServerThatNeverAnswersIsGivenUp)
{
    offer("/silent", "", Then::kStall);
    auto impatient = host.impatient();
    expectFailure(impatient, server.url(L"/silent"), "timed out");
}

TEST_F(Remote, ARedirectionIsFollowed)
{
    offer("/old.lsp", httpAnswer("302 Found", "look there", "Location: /new.lsp\r\n"));
    offer("/new.lsp", httpAnswer("200 OK", "new"));
    const Copy copy = host.fetch(server.url(L"/old.lsp"));
    EXPECT_EQ(copy.status, TS_FETCHED);
    EXPECT_EQ(host.content(copy.path), "new");
    EXPECT_THAT(tessel::toUtf8(copy.path), EndsWith("/old.lsp"));
    wchar_t origin[1024] = {};
    EXPECT_TRUE(host.remote().IsRemoteFile(copy.path.c_str(), origin, 1024));
    EXPECT_EQ(origin, server.url(L"/old.lsp")) << "what was asked for";
}

TEST_F(Remote, ARedirectionToAnotherKindOfAddressIsRefused)
{
    const fs::path secret = host.folder().write("secret", "local");
    offer("/file", httpAnswer("302 Found", "", "Location: file://" + secret.string() + "\r\n"));
    offer("/ftp", httpAnswer("301 Moved", "", "Location: ftp://127.0.0.1/x\r\n"));
    offer("/gopher", httpAnswer("307 Moved", "", "Location: gopher://127.0.0.1/x\r\n"));
    expectFailure("/file", "\"file\" not supported or disabled");
    expectFailure("/ftp", "\"ftp\" not supported or disabled");
    expectFailure("/gopher", "\"gopher\" not supported or disabled");
}

TEST_F(Remote, ACircleOfRedirectionsEnds)
{
    offer("/round", httpAnswer("302 Found", "", "Location: /round\r\n"));
    expectFailure("/round", "redirects");
    EXPECT_LE(server.requests().size(), 10u);
}

TEST_F(Remote, AFileBeyondTheLimitIsRefused)
{
    const std::string piece(10'000, 'x');
    offer("/told", kHeadOfMillion, Then::kRepeat, piece);
    offer("/chunked", kChunkedHead, Then::kRepeat, chunk(piece));
    offer("/untold", "HTTP/1.0 200 OK\r\n\r\n", Then::kRepeat, piece);
    offer("/one-more", httpAnswer("200 OK", std::string(RemoteHost::kMostBytes + 1, 'x')));
    for (const char* target : {"/told", "/chunked", "/untold", "/one-more"})
        expectFailure(target, "it is larger than 100000 bytes");
}

TEST_F(Remote, AClosedPortIsAFailure)
{
    std::uint16_t port = 0;
    const int closed = bindLoopback(port); // bound, so that nobody else listens there
    expectFailure(host.remote(), L"http://127.0.0.1:" + std::to_wstring(port) + L"/tool.lsp",
                  "Failed to connect");
    close(closed);
}

TEST_F(Remote, AFailedFetchKeepsTheEarlierCopy)
{
    offer("/tool.lsp", httpAnswer("200 OK", "earlier"));
    const Copy earlier = host.fetch(server.url(L"/tool.lsp"));
    const std::string failures[] = {httpAnswer("404 Not Found", ""),
                                    "HTTP/1.1 200 OK\r\nContent-Length: 1000\r\n\r\ncut",
                                    httpAnswer("200 OK", std::string(RemoteHost::kMostBytes + 1, 'x'))};
    for (const std::string& failure : failures)
    {
        offer("/tool.lsp", failure);
        expectFailure(host.remote(), server.url(L"/tool.lsp"), "", true);
    }
    EXPECT_EQ(host.content(earlier.path), "earlier");
    EXPECT_EQ(host.fetch(server.url(L"/tool.lsp")).status, TS_FROM_CACHE);
    EXPECT_TRUE(host.remote().IsRemoteFile(earlier.path.c_str(), nullptr, 0));
}

TEST_F(Remote, ACacheThatCannotBeMadeIsAFailure)
{
    offer("/tool.lsp", httpAnswer("200 OK", "1"));
    host.folder().write("cache", "a file in its place");
    expectFailure("/tool.lsp", "the cache folder " + host.cache().string());
    EXPECT_THAT(server.requests(), IsEmpty());
}

TEST_F(Remote, ACopyThatCannotBeMadeIsAFailure)
{
    offer("/tool.lsp", httpAnswer("200 OK", "1"));
    const fs::path copy = tessel::toUtf8(host.fetch(server.url(L"/tool.lsp")).path);
    ASSERT_TRUE(copy.is_absolute()) << "the folder would be made where the test runs";
    fs::remove(copy);
    fs::create_directories(copy / "in the way");
    expectFailure("/tool.lsp", "the local copy " + copy.string() + " cannot be made: ");
}

TEST_F(Remote, AFullDiskIsAFailure)
{
    offer("/tool.lsp", httpAnswer("200 OK", std::string(50'000, 'x')));
    std::signal(SIGXFSZ, SIG_IGN);
    rlimit limit = {};
    getrlimit(RLIMIT_FSIZE, &limit);
    const rlimit small = {1000, limit.rlim_max};
    ASSERT_EQ(setrlimit(RLIMIT_FSIZE, &small), 0);
    expectFailure("/tool.lsp", "the local copy could not be written");
    offer("/small.lsp", httpAnswer("200 OK", std::string(1001, 'x')));
    expectFailure("/small.lsp", "the local copy could not be written");
    setrlimit(RLIMIT_FSIZE, &limit);
}

TEST_F(Remote, APathThatIsTooLongForItsUserIsAFailure)
{
    offer("/tool.lsp", httpAnswer("200 OK", "1"));
    const std::size_t length = host.fetch(server.url(L"/tool.lsp")).path.size();
    const auto before = host.stored();
    EXPECT_EQ(host.told(host.remote().fetch(server.url(L"/tool.lsp"), length, true)).status, TS_FETCHED);
    EXPECT_EQ(host.told(host.remote().fetch(server.url(L"/tool.lsp"), length - 1, true)).status,
              TS_FETCH_FAILED);
    EXPECT_THAT(host.output().text(),
                HasSubstr("the path of its local copy has more than " + std::to_string(length - 1)));
    EXPECT_EQ(host.stored(), before);
    EXPECT_EQ(server.requests().size(), 2u) << "nothing was fetched in vain";
}
