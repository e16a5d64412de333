// Addresses instead of paths: fetched from a web server on loopback into the host's cache.
#include "tests/integration/ModrigInHost.h"

#include <algorithm>
#include <map>

#include <gmock/gmock.h>

#include "host/files/RemoteFiles.h"
#include "tests/support/HttpServer.h"

using testing::AllOf;
using testing::ElementsAre;
using testing::EndsWith;
using testing::HasSubstr;
using testing::StartsWith;

namespace
{
using namespace std::chrono_literals;

using Then = HttpServer::Then;

constexpr char kMessage39[] = "Message: The file could not be fetched from the Internet.\n";
constexpr char kHeadOfMillion[] = "HTTP/1.1 200 OK\r\nContent-Length: 1000000\r\n\r\n";

class RemoteFiles : public ModrigInHost
{
protected:
    RemoteFiles()
    {
        // A test does not wait for a minute.
        options.downloads = {.bytes = 5000, .connecting = 2000ms, .whole = 300ms};
        restart();
        loadModrig();
        said();
    }

    std::filesystem::path cache() const { return profile() / "remote-files"; }

    void offer(const std::string& target, const std::string& bytes, Then then = Then::kClose,
               const std::string& repeat = "")
    {
        mAnswers[target] = {bytes, repeat, then};
    }

    std::wstring fetch(const std::wstring& address)
    {
        std::wstring path = address;
        dialog([&] { ModrigUnderTest::fetch(path); });
        return path;
    }

    bool isTemporary(const std::wstring& path)
    {
        bool answer = false;
        dialog([&] { answer = ModrigUnderTest::isTemporaryInternetFile(path); });
        return answer;
    }

    // The host says why, Modrig that it failed, and the cache is as empty as it was.
    void expectMessage39(const std::wstring& target, const std::string& reason)
    {
        const std::wstring address = server.url(target);
        EXPECT_EQ(fetch(address), address);
        const std::string told = said();
        EXPECT_THAT(told,
                    AllOf(StartsWith(std::string(address.begin(), address.end()) + " could not be fetched: "),
                          HasSubstr(reason), EndsWith(".\n" + std::string(kMessage39))));
        EXPECT_EQ(std::ranges::count(told, '\n'), 2) << told;
        EXPECT_FALSE(std::filesystem::exists(cache()) && !std::filesystem::is_empty(cache()));
    }

private:
    std::map<std::string, HttpServer::Answer> mAnswers; // changed only between requests

protected:
    HttpServer server{[this](const std::string& target)
                      {
                          const auto found = mAnswers.find(target);
                          return found == mAnswers.end()
                                     ? HttpServer::Answer{httpAnswer("404 Not Found", "none"), "", {}}
                                     : found->second;
                      }};
};
} // namespace

TEST_F(RemoteFiles, AreFetchedThenTakenFromTheCacheAndCountAsTemporary)
{
    offer("/tools/tool.lsp", httpAnswer("200 OK", "(write-line \"from afar\")\n"));
    const std::wstring copy = fetch(server.url(L"/tools/tool.lsp"));
    EXPECT_TRUE(copy.starts_with(wide(cache())) && copy.ends_with(L"/tool.lsp"))
        << std::filesystem::path(copy);
    EXPECT_EQ(fetch(server.url(L"/tools/tool.lsp")), copy);
    EXPECT_THAT(server.requests(), ElementsAre("/tools/tool.lsp"));
    EXPECT_TRUE(isTemporary(copy));
    EXPECT_FALSE(isTemporary(wide(folder.write("tool.lsp", ""))));
    EXPECT_EQ(said(), "");
    dialog([&] { EXPECT_EQ(ModrigUnderTest::load(copy, true, false), 1); });
    EXPECT_EQ(said(), "from afar\n\nReady. ");
}

TEST_F(RemoteFiles, AreFetchedWithoutTheSeparatorsAtTheirEnd)
{
    offer("/tool.lsp", httpAnswer("200 OK", "(list 1)\n"));
    const std::wstring copy = fetch(server.url(L"/tool.lsp") + L"//\\\\");
    EXPECT_TRUE(copy.ends_with(L"/tool.lsp")) << std::filesystem::path(copy);
    EXPECT_TRUE(isTemporary(copy));
}

TEST_F(RemoteFiles, AreNotWhatOtherPathsAreTakenFor)
{
    for (const std::wstring path : {L"", L"/a/tool.lsp", L"/a/folder//", L"ftp://host/tool.lsp", L"////"})
        EXPECT_EQ(fetch(path), path);
    EXPECT_EQ(said(), "");
}

TEST_F(RemoteFiles, ThatTheServerDoesNotHaveAreTold)
{
    expectMessage39(L"/missing.lsp", "404");
}

TEST_F(RemoteFiles, ThatFailAreLeftWithoutTheSeparatorsAtTheirEnd)
{
    const std::wstring address = server.url(L"/missing.lsp");
    EXPECT_EQ(fetch(address + L"/"), address);
}

TEST_F(RemoteFiles, WhoseBodyIsCutShortAreTold)
{
    offer("/short.lsp", "HTTP/1.1 200 OK\r\nContent-Length: 1000\r\n\r\n(write-line");
    expectMessage39(L"/short.lsp", "bytes remaining to read");
}

TEST_F(RemoteFiles, ThatNeverEndAreGivenUp)
{
    offer("/endless.lsp", "HTTP/1.1 200 OK\r\n\r\n(list 1)\n", Then::kStall);
    expectMessage39(L"/endless.lsp", "timed out");
}

TEST_F(RemoteFiles, FromAServerThatNeverAnswersAreGivenUp)
{
    offer("/silent.lsp", "", Then::kStall);
    expectMessage39(L"/silent.lsp", "timed out");
}

TEST_F(RemoteFiles, BeyondTheLimitAreRefused)
{
    offer("/announced.lsp", kHeadOfMillion + std::string(100, ';'), Then::kStall);
    expectMessage39(L"/announced.lsp", "5000 bytes");
    offer("/growing.lsp", "HTTP/1.1 200 OK\r\n\r\n", Then::kRepeat, std::string(1000, ';'));
    expectMessage39(L"/growing.lsp", "5000 bytes");
}

TEST_F(RemoteFiles, ThatAreRedirectedToAFileAreRefused)
{
    const std::string secret = folder.write("secret.lsp", "(list 1)\n");
    offer("/elsewhere.lsp", httpAnswer("302 Found", "", "Location: file://" + secret + "\r\n"));
    expectMessage39(L"/elsewhere.lsp", "\"file\" not supported or disabled");
}
