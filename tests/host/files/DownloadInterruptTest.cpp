// A download that another thread stops, with the threads of the network library and of a server at work.
#include <functional>
#include <string>

#include <gtest/gtest.h>

#include "host/commands/Interruption.h"
#include "host/files/RemoteFiles.h"
#include "tests/support/HttpServer.h"
#include "tests/support/TemporaryFolder.h"

namespace
{
constexpr std::size_t kLongestPath = 1023;

class InterruptedDownload : public testing::Test
{
protected:
    std::wstring fetch()
    {
        const auto copy = mFiles.fetch(mServer.url(L"/endless.lsp"), kLongestPath, false);
        EXPECT_FALSE(copy);
        return copy.sentence();
    }

    tessel::EndRequest mEndRequest;
    tessel::Interruption mInterruption{mEndRequest};
    std::function<void()> mAsked;

private:
    TemporaryFolder mFolder;
    tessel::RemoteFiles mFiles{mFolder / "cache", {}, mInterruption};
    HttpServer mServer{[this](const std::string&)
                       {
                           mAsked();
                           return HttpServer::Answer{"HTTP/1.1 200 OK\r\nContent-Length: 60000000\r\n\r\n",
                                                     std::string(100, 'x'), HttpServer::Then::kRepeat};
                       }};
};
} // namespace

TEST_F(InterruptedDownload, EndsWhenTheKeyIsPressed)
{
    mAsked = [this]
    {
        mInterruption.press(0);
    };
    EXPECT_TRUE(fetch().ends_with(L" could not be fetched: it was interrupted."));
}

TEST_F(InterruptedDownload, EndsWhenTheSessionIsToEnd)
{
    mAsked = [this]
    {
        mEndRequest.make();
    };
    EXPECT_TRUE(fetch().ends_with(L" could not be fetched: it was interrupted."));
}
