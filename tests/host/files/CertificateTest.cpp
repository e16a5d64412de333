#include <gmock/gmock.h>

#include <cstdio>
#include <cstdlib>

#include <unistd.h>

#include <tessel/tsdefs.h>

#include "tests/host/files/RemoteHost.h"
#include "tests/support/ChildProcess.h"
#include "tests/support/HttpServer.h"

using testing::AllOf;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::StartsWith;

TEST(Https, ServerThatNobodyVouchesForIsRefused)
{
    RemoteHost host;
    const std::string folder = host.folder().path().string();
    const std::string make = "cd '" + folder +
                             "' && openssl req -x509 -newkey ec -pkeyopt ec_paramgen_curve:prime256v1 -nodes "
                             "-keyout key -out certificate -days 2 -subj /CN=127.0.0.1 2>/dev/null";
    ASSERT_EQ(std::system(make.c_str()), 0);
    const ChildProcess server(
        [&folder](int output)
        {
            if (chdir(folder.c_str()) == 0 && dup2(output, STDOUT_FILENO) >= 0 &&
                std::freopen("/dev/null", "w", stderr))
                execlp("openssl", "openssl", "s_server", "-accept", "127.0.0.1:0", "-cert", "certificate",
                       "-key", "key", "-WWW", nullptr);
            _exit(1);
        });
    std::string line = server.readLine();
    while (!line.empty() && !line.starts_with("ACCEPT"))
        line = server.readLine();
    ASSERT_THAT(line, StartsWith("ACCEPT"));
    const std::wstring url =
        L"https://127.0.0.1:" + tessel::toWide(line.substr(line.rfind(':') + 1)) + L"/certificate";
    EXPECT_EQ(host.fetch(url).status, TS_FETCH_FAILED);
    EXPECT_THAT(host.output().text(),
                AllOf(StartsWith(tessel::toUtf8(url) + " could not be fetched: "), HasSubstr("certificate")));
    EXPECT_THAT(host.stored(), IsEmpty());
}

TEST(Https, ServerThatSpeaksInTheClearIsRefused)
{
    const HttpServer server(
        [](const std::string&) {
            return HttpServer::Answer{httpAnswer("200 OK", "1"), "", {}};
        });
    RemoteHost host;
    const std::wstring url = L"https" + server.url(L"/tool.lsp").substr(4);
    auto impatient = host.impatient();
    EXPECT_EQ(host.told(impatient.fetch(url, RemoteHost::kLongestPath, false)).status, TS_FETCH_FAILED);
    EXPECT_THAT(host.output().text(), StartsWith(tessel::toUtf8(url) + " could not be fetched: "));
    EXPECT_THAT(host.stored(), IsEmpty());
}
