#include "tests/support/HttpServer.h"

#include <stdexcept>

#include <arpa/inet.h>
#include <netinet/in.h>
#include <sys/socket.h>
#include <unistd.h>

namespace
{
constexpr int kBacklog = 16;

bool sendAll(int connection, const std::string& bytes)
{
    std::size_t sent = 0;
    while (sent < bytes.size())
    {
        const ssize_t count = send(connection, bytes.data() + sent, bytes.size() - sent, MSG_NOSIGNAL);
        if (count <= 0)
            return false;
        sent += static_cast<std::size_t>(count);
    }
    return true;
}

std::string readHead(int connection)
{
    std::string head;
    char character = 0;
    while (!head.ends_with("\r\n\r\n") && recv(connection, &character, 1, 0) == 1)
        head += character;
    return head;
}

// Waits until the client has closed its end, so that closing ours loses nothing of what was sent.
void closeGently(int connection)
{
    shutdown(connection, SHUT_WR);
    char rest[1024];
    while (recv(connection, rest, sizeof rest, 0) > 0)
        continue;
    close(connection);
}
} // namespace

int bindLoopback(std::uint16_t& port)
{
    const int socketDescriptor = socket(AF_INET, SOCK_STREAM, 0);
    sockaddr_in address = {};
    address.sin_family = AF_INET;
    address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    socklen_t size = sizeof address;
    auto* generic = reinterpret_cast<sockaddr*>(&address);
    if (socketDescriptor < 0 || bind(socketDescriptor, generic, size) != 0 ||
        getsockname(socketDescriptor, generic, &size) != 0)
        throw std::runtime_error("no free port");
    port = ntohs(address.sin_port);
    return socketDescriptor;
}

HttpServer::HttpServer(Handler handler) : mHandler(std::move(handler)), mListener(bindLoopback(mPort))
{
    if (listen(mListener, kBacklog) != 0)
        throw std::runtime_error("cannot listen");
    mThread = std::thread([this] { serve(); });
}

HttpServer::~HttpServer()
{
    mEnding = true;
    shutdown(mListener, SHUT_RDWR); // wakes the thread
    mThread.join();
    close(mListener);
    for (const int connection : mStalled)
        close(connection);
}

std::wstring HttpServer::url(const std::wstring& target) const
{
    return L"http://127.0.0.1:" + std::to_wstring(mPort) + target;
}

std::vector<std::string> HttpServer::requests() const
{
    const std::lock_guard lock(mMutex);
    return mRequests;
}

std::vector<std::string> HttpServer::heads() const
{
    const std::lock_guard lock(mMutex);
    return mHeads;
}

void HttpServer::serve()
{
    while (!mEnding)
        if (const int connection = accept(mListener, nullptr, nullptr); connection >= 0)
            answer(connection);
}

void HttpServer::answer(int connection)
{
    const std::string head = readHead(connection);
    const std::size_t start = head.find(' ') + 1;
    const std::string target = head.substr(start, head.find(' ', start) - start);
    {
        const std::lock_guard lock(mMutex);
        mRequests.push_back(target);
        mHeads.push_back(head);
    }
    const Answer reply = mHandler(target);
    bool open = sendAll(connection, reply.bytes);
    while (reply.then == Then::kRepeat && open && !mEnding)
        open = sendAll(connection, reply.repeat);
    if (reply.then == Then::kStall)
        mStalled.push_back(connection);
    else
        closeGently(connection);
}

std::string httpAnswer(const std::string& status, const std::string& body, const std::string& headers)
{
    return "HTTP/1.1 " + status + "\r\nContent-Length: " + std::to_string(body.size()) + "\r\n" + headers +
           "Connection: close\r\n\r\n" + body;
}
