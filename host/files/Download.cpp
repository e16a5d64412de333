#include "host/files/Download.h"

#include <chrono>
#include <memory>

#include "host/commands/Interruption.h"
#include "host/files/NetworkLibrary.h"
#include "host/files/RemoteAddress.h"
#include "host/files/network/Network.h"
#include "host/platform/PartFile.h"
#include "host/text/Sizes.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr std::chrono::seconds kPatience{2}; // without a word
constexpr long kWholeFile = 200;             // of the other answers none brings the file that was asked for

class Sink final : public TransferWatch
{
public:
    Sink(PartFile& part, std::uint64_t most, const Interruption& interruption,
         const std::function<void(std::uint64_t)>& tellBytes, std::unique_ptr<Checksum> sum)
        : file(part), limit(most), interrupted(interruption), tell(tellBytes), checksum(std::move(sum))
    {
    }

    bool isFull() const { return received > limit; }

    // A body sent in chunks does not say its length before, so that the bytes are counted as they come.
    bool receive(std::string_view bytes) override
    {
        received += bytes.size();
        if (isFull())
            return false;
        checksum->add(bytes);
        written = static_cast<bool>(file.write(bytes));
        return written;
    }

    bool goesOn() override
    {
        stopped = interrupted.isThere();
        if (const auto now = Clock::now(); now - told >= kPatience)
        {
            told = now;
            tell(received);
        }
        return !stopped;
    }

    bool mayAsk(const char* url) override
    {
        const bool secure = isSecure(url);
        ledAstray = wasSecure && !secure;
        wasSecure = secure;
        return !ledAstray;
    }

    using Clock = std::chrono::steady_clock;

    PartFile& file;
    std::uint64_t limit;
    Interruption::Wish interrupted;
    const std::function<void(std::uint64_t)>& tell;
    std::unique_ptr<Checksum> checksum;
    Clock::time_point told = Clock::now();
    std::uint64_t received = 0;
    bool written = true;
    bool stopped = false;
    bool wasSecure = false;
    bool ledAstray = false; // from where nobody can read along to where anybody can
};

TransferOrder orderFor(const RemoteAddress& address, const RemoteFiles::Limits& limits)
{
    return {address.url, address.user, address.password, limits.bytes, limits.connecting, limits.whole};
}

// What stopped the transfer on this side; nothing when the other one did, or nobody.
Result<> ownOutcome(TransferEnd end, const Sink& sink)
{
    if (sink.stopped)
        return Failure{translated(L"it was interrupted")};
    if (sink.ledAstray)
        return Failure{translated(L"the server leads from https to http")};
    if (sink.isFull() || end == TransferEnd::kTooLarge)
        return Failure{translated(L"it is larger than {}", sizeInWords(sink.limit))};
    return sink.written ? Result<>() : Failure{translated(L"the local copy could not be written")};
}

Result<> outcomeOf(const TransferResult& result, const Sink& sink)
{
    if (auto own = ownOutcome(result.end, sink); !own)
        return own;
    if (result.end == TransferEnd::kNotStarted)
        return Failure{translated(L"the network library cannot be started")};
    if (result.end == TransferEnd::kFailed)
        return Failure{toWide(result.words)};
    if (result.answer != kWholeFile)
        return Failure{translated(L"the server answered {}", result.answer)};
    return {};
}
} // namespace

Result<std::string> download(const RemoteAddress& address, PartFile& file, const RemoteFiles::Limits& limits,
                             Interruption& interruption, const std::function<void(std::uint64_t)>& tell)
{
    const auto net = network();
    if (!net)
        return net.failure();
    Sink sink(file, limits.bytes, interruption, tell, (*net)->checksum());
    const auto outcome = outcomeOf((*net)->transfer(orderFor(address, limits), sink), sink);
    if (sink.stopped)
        interruption.settle();
    return outcome ? Result<std::string>(sink.checksum->finish()) : outcome.failure();
}
} // namespace tessel
