// Addresses that nobody else can read along: https.
#include <gmock/gmock.h>

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <memory>

#include <unistd.h>

#include "tests/e2e/HostProcess.h"
#include "tests/support/ChildProcess.h"
#include "tests/support/HttpServer.h"

namespace fs = std::filesystem;

using testing::AllOf;
using testing::Each;
using testing::EndsWith;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;

namespace
{
// A server with a certificate of its own; it answers with the files of a folder, byte for byte.
class SecureServer
{
public:
    explicit SecureServer(const fs::path& folder) : mFolder(folder)
    {
        const std::string make =
            "cd '" + folder.string() +
            "' && openssl req -x509 -newkey ec -pkeyopt ec_paramgen_curve:prime256v1 -nodes "
            "-keyout key -out certificate -days 2 -subj /CN=127.0.0.1 "
            "-addext subjectAltName=IP:127.0.0.1 2>/dev/null";
        if (std::system(make.c_str()) != 0)
            throw std::runtime_error("no certificate");
        mProcess = std::make_unique<ChildProcess>([this](int output) { run(output); });
        std::string line = mProcess->readLine();
        while (!line.empty() && !line.starts_with("ACCEPT"))
            line = mProcess->readLine();
        mPort = line.substr(line.rfind(':') + 1);
    }

    std::string url(const std::string& target) const { return "https://127.0.0.1:" + mPort + target; }
    fs::path certificate() const { return mFolder / "certificate"; }

private:
    void run(int output) const
    {
        if (chdir(mFolder.c_str()) == 0 && dup2(output, STDOUT_FILENO) >= 0 &&
            std::freopen("/dev/null", "w", stderr))
            execlp("openssl", "openssl", "s_server", "-accept", "127.0.0.1:0", "-cert", "certificate", "-key",
                   "key", "-HTTP", nullptr);
        _exit(1);
    }

    fs::path mFolder;
    std::unique_ptr<ChildProcess> mProcess;
    std::string mPort;
};

class SecureAddresses : public testing::Test
{
protected:
    SecureAddresses()
    {
        session.alwaysWith({"--safe"});
        session.set("SSL_CERT_FILE", server.certificate().string());
    }

    void offer(const std::string& name, const std::string& answer) const
    {
        session.folder().write("server/" + name, answer);
    }
    HostResult load(const std::string& address) const { return session.run({"LOAD " + address}); }

    HostSession session;
    SecureServer server{session.folder()
                            .write("server/tool.lsp", httpAnswer("200 OK", "(write-line \"it runs\")\n"))
                            .parent_path()};
};
} // namespace

TEST_F(SecureAddresses, AreFetchedFromAServerThatThePersonTrusts)
{
    const auto result = load(server.url("/tool.lsp"));
    EXPECT_EQ(result.exitStatus, 0) << result.output;
    EXPECT_THAT(result.output, HasSubstr("\nit runs\n"));
}

TEST_F(SecureAddresses, AreRefusedWhereNobodyVouchesForTheServer)
{
    session.set("SSL_CERT_FILE", "");
    const auto result = load(server.url("/tool.lsp"));
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_THAT(result.output, AllOf(HasSubstr(" could not be fetched: "), HasSubstr("certificate")));
}

TEST_F(SecureAddresses, MayLeadToOthersOfTheirKind)
{
    offer("old.lsp", httpAnswer("302 Found", "", "Location: " + server.url("/tool.lsp") + "\r\n"));
    EXPECT_THAT(load(server.url("/old.lsp")).output, HasSubstr("\nit runs\n"));
}

TEST_F(SecureAddresses, DoNotLeadToWhatAnybodyCanReadAlong)
{
    const HttpServer open(
        [](const std::string&) {
            return HttpServer::Answer{httpAnswer("200 OK", "(write-line \"taken\")\n"), "", {}};
        });
    const std::wstring address = open.url(L"/tool.lsp");
    offer("old.lsp",
          httpAnswer("302 Found", "", "Location: " + std::string(address.begin(), address.end()) + "\r\n"));
    const auto result = load(server.url("/old.lsp"));
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_THAT(result.output, EndsWith("\n" + server.url("/old.lsp") +
                                        " could not be fetched: the server leads from https to http.\n"));
    EXPECT_THAT(open.heads(), Each(IsEmpty())) << "nothing is sent";
    EXPECT_TRUE(fs::is_empty(session.profile() / "remote-files"));
}

TEST_F(SecureAddresses, DoNotLeadThereRoundAboutEither)
{
    const HttpServer open(
        [this](const std::string& target)
        {
            const std::string on = "Location: " + server.url("/old.lsp") + "\r\n";
            return HttpServer::Answer{target == "/start.lsp"
                                          ? httpAnswer("302 Found", "", on)
                                          : httpAnswer("200 OK", "(write-line \"taken\")\n"),
                                      "",
                                      {}};
        });
    const auto address = [&](const std::wstring& target)
    {
        const std::wstring wide = open.url(target);
        return std::string(wide.begin(), wide.end());
    };
    offer("old.lsp", httpAnswer("302 Found", "", "Location: " + address(L"/end.lsp") + "\r\n"));
    const auto result = load(address(L"/start.lsp"));
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_THAT(result.output, HasSubstr("the server leads from https to http"));
    EXPECT_EQ(std::ranges::count_if(open.heads(), [](const std::string& head) { return !head.empty(); }), 1);
}
