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
constexpr std::chrono::seconds kLongestSilence{2}; // without a word
constexpr long kWholeFile = 200; // of the other answers none brings the file that was asked for

// Takes what comes, and knows what has ended the transfer on this side.
class Sink final : public TransferWatch
{
public:
    Sink(PartFile& file, std::uint64_t limit, const Interruption& interruption,
         const std::function<void(std::uint64_t)>& tell, std::unique_ptr<Checksum> checksum)
        : mFile(file), mLimit(limit), mInterrupted(interruption), mTell(tell), mChecksum(std::move(checksum))
    {
    }

    // A body sent in chunks does not say its length before, so that the bytes are counted as they come.
    bool receive(std::string_view bytes) override
    {
        mReceived += bytes.size();
        if (isFull())
            return false;
        mChecksum->add(bytes);
        mWritten = static_cast<bool>(mFile.write(bytes));
        return mWritten;
    }

    bool goesOn() override
    {
        mStopped = mInterrupted.isThere();
        if (const auto now = Clock::now(); now - mTold >= kLongestSilence)
        {
            mTold = now;
            mTell(mReceived);
        }
        return !mStopped;
    }

    bool mayAsk(const char* url) override
    {
        const bool secure = isSecure(url);
        mLedAstray = mWasSecure && !secure;
        mWasSecure = secure;
        return !mLedAstray;
    }

    // Fails when the transfer ended on this side.
    Result<> outcome(TransferEnd end) const
    {
        if (mStopped)
            return Failure{translated(L"it was interrupted")};
        if (mLedAstray)
            return Failure{translated(L"the server leads from https to http")};
        if (isFull() || end == TransferEnd::kTooLarge)
            return Failure{translated(L"it is larger than {}", sizeInWords(mLimit))};
        return mWritten ? Result<>() : Failure{translated(L"the local copy could not be written")};
    }

    bool wasStopped() const { return mStopped; }
    std::string sha256() { return mChecksum->finish(); }

private:
    using Clock = std::chrono::steady_clock;

    bool isFull() const { return mReceived > mLimit; }

    PartFile& mFile;
    std::uint64_t mLimit;
    Interruption::Wish mInterrupted;
    const std::function<void(std::uint64_t)>& mTell;
    std::unique_ptr<Checksum> mChecksum;
    Clock::time_point mTold = Clock::now();
    std::uint64_t mReceived = 0;
    bool mWritten = true;
    bool mStopped = false;
    bool mWasSecure = false;
    bool mLedAstray = false; // from where nobody can read along to where anybody can
};

TransferOrder orderFor(const RemoteAddress& address, const RemoteFiles::Limits& limits)
{
    return {address.url, address.user, address.password, limits.bytes, limits.connecting, limits.whole};
}

Result<> outcomeOf(const TransferResult& result, const Sink& sink)
{
    if (auto own = sink.outcome(result.end); !own)
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
    if (sink.wasStopped())
        interruption.settle();
    return outcome ? Result<std::string>(sink.sha256()) : outcome.failure();
}
} // namespace tessel
