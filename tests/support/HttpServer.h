// A web server on loopback that answers as told, byte by byte.
#pragma once

#include <atomic>
#include <cstdint>
#include <functional>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

class HttpServer
{
public:
    // What becomes of the connection when the answer is sent.
    enum class Then
    {
        kClose,
        kStall,  // open and silent until the server ends
        kRepeat, // the last piece again and again until the client goes
    };

    struct Answer
    {
        std::string bytes;  // status line, headers and body
        std::string repeat; // for kRepeat
        Then then = Then::kClose;
    };

    // Given the target of the request: "/tool.lsp?x=1".
    using Handler = std::function<Answer(const std::string& target)>;

    explicit HttpServer(Handler handler);
    ~HttpServer();
    HttpServer(const HttpServer&) = delete;
    HttpServer& operator=(const HttpServer&) = delete;

    std::wstring url(const std::wstring& target) const;
    // The targets asked for, in order.
    std::vector<std::string> requests() const;
    // What was sent for each, its headers and all.
    std::vector<std::string> heads() const;

private:
    void serve();
    void answer(int connection);

    Handler mHandler;
    std::uint16_t mPort = 0;
    int mListener; // made after the port's place, which it fills
    std::atomic<bool> mEnding = false;
    mutable std::mutex mMutex;
    std::vector<std::string> mRequests;
    std::vector<std::string> mHeads;
    std::vector<int> mStalled;
    std::thread mThread;
};

// A whole answer with the body and its length.
std::string httpAnswer(const std::string& status, const std::string& body, const std::string& headers = "");

// A socket bound to a free port of loopback, and the port.
int bindLoopback(std::uint16_t& port);
