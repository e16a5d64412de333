// What the network's library does for the host: transfers, and the checksums of what they bring. It is a
// library of its own, with all the libraries that it stands on: most sessions fetch nothing, and do without
// them.
#pragma once

#include <chrono>
#include <cstdint>
#include <memory>
#include <string>
#include <string_view>

namespace tessel
{
// The SHA-256 of bytes (FIPS 180-4).
class Checksum
{
public:
    virtual ~Checksum() = default;

    virtual void add(std::string_view bytes) = 0;

    // 64 hexadecimal digits in small letters; nothing can be added after it.
    virtual std::string finish() = 0;
};

// Who has ordered a transfer is asked while it goes on; each "no" ends it.
class TransferWatch
{
public:
    virtual ~TransferWatch() = default;

    // Before each request, that of a redirection too.
    virtual bool mayAsk(const char* url) = 0;
    virtual bool receive(std::string_view bytes) = 0;
    // Several times a second.
    virtual bool goesOn() = 0;
};

struct TransferOrder
{
    std::string url; // http or https
    std::string user;
    std::string password; // sent to the server of the address alone, wherever that leads
    std::uint64_t mostBytes = 0;
    std::chrono::milliseconds connecting{};
    std::chrono::milliseconds whole{};
};

enum class TransferEnd
{
    kNotStarted,
    kFailed,
    kTooLarge, // as the server has said beforehand
    kAnswered
};

struct TransferResult
{
    TransferEnd end = TransferEnd::kNotStarted;
    std::string words; // why it failed, in those of the library
    long answer = 0;   // the number that the server answered with
};

class Network
{
public:
    virtual ~Network() = default;

    virtual TransferResult transfer(const TransferOrder& order, TransferWatch& watch) = 0;
    virtual std::unique_ptr<Checksum> checksum() = 0;
};
} // namespace tessel
