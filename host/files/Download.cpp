#include "host/files/Download.h"

#include <curl/curl.h>

#include <chrono>
#include <cstdlib>
#include <memory>

#include "host/commands/Interruption.h"
#include "host/files/RemoteAddress.h"
#include "host/files/Sha256.h"
#include "host/platform/PartFile.h"
#include "host/text/Sizes.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr const char* kProtocols = "http,https"; // for redirections too: a server must not name local files
constexpr long kMostRedirections = 5;
constexpr std::chrono::seconds kPatience{2}; // without a word
constexpr long kWholeFile = 200;             // of the other answers none brings the file that was asked for

struct Sink
{
    using Clock = std::chrono::steady_clock;

    Sink(PartFile& part, std::uint64_t most, const Interruption& interruption,
         const std::function<void(std::uint64_t)>& tellBytes)
        : file(part), limit(most), interrupted(interruption), tell(tellBytes)
    {
    }

    PartFile& file;
    std::uint64_t limit;
    Interruption::Wish interrupted;
    const std::function<void(std::uint64_t)>& tell;
    Clock::time_point told = Clock::now();
    Sha256 sha256{};
    std::uint64_t received = 0;
    bool written = true;
    bool stopped = false;
    bool wasSecure = false;
    bool ledAstray = false; // from where nobody can read along to where anybody can
    CURL* transfer = nullptr;

    bool isFull() const { return received > limit; }
};

// A body sent in chunks does not say its length before, so that the bytes are counted as they come.
std::size_t receive(char* bytes, std::size_t size, std::size_t count, void* context)
{
    auto& sink = *static_cast<Sink*>(context);
    sink.received += size * count;
    if (sink.isFull())
        return 0;
    sink.sha256.add({bytes, size * count});
    sink.written = static_cast<bool>(sink.file.write({bytes, size * count}));
    return sink.written ? size * count : 0;
}

int onProgress(void* context, curl_off_t, curl_off_t, curl_off_t, curl_off_t)
{
    auto& sink = *static_cast<Sink*>(context);
    sink.stopped = sink.interrupted.isThere();
    if (const auto now = Sink::Clock::now(); now - sink.told >= kPatience)
    {
        sink.told = now;
        sink.tell(sink.received);
    }
    return sink.stopped ? 1 : 0;
}

// Before each request, that of a redirection too.
int beforeRequest(void* context, char*, char*, int, int)
{
    auto& sink = *static_cast<Sink*>(context);
    const char* url = nullptr;
    curl_easy_getinfo(sink.transfer, CURLINFO_EFFECTIVE_URL, &url);
    const bool secure = url && isSecure(url);
    sink.ledAstray = sink.wasSecure && !secure;
    sink.wasSecure = secure;
    return sink.ledAstray ? CURL_PREREQFUNC_ABORT : CURL_PREREQFUNC_OK;
}

struct EndTransfer
{
    void operator()(CURL* transfer) const { curl_easy_cleanup(transfer); }
};
using Transfer = std::unique_ptr<CURL, EndTransfer>;

// Whom to trust is the system's to know, or that of the person who has a certificate of their own.
void configureTrust(CURL* transfer)
{
    if (const char* certificates = std::getenv("SSL_CERT_FILE"); certificates && *certificates)
        curl_easy_setopt(transfer, CURLOPT_CAINFO, certificates);
}

void configureAddress(CURL* transfer, const RemoteAddress& address)
{
    curl_easy_setopt(transfer, CURLOPT_URL, address.url.c_str());
    curl_easy_setopt(transfer, CURLOPT_PROTOCOLS_STR, kProtocols);
    curl_easy_setopt(transfer, CURLOPT_REDIR_PROTOCOLS_STR, kProtocols);
    curl_easy_setopt(transfer, CURLOPT_FOLLOWLOCATION, 1L);
    curl_easy_setopt(transfer, CURLOPT_MAXREDIRS, kMostRedirections);
    if (!address.hasCredentials())
        return;
    // Sent to the server of the address alone, wherever that leads.
    curl_easy_setopt(transfer, CURLOPT_USERNAME, address.user.c_str());
    curl_easy_setopt(transfer, CURLOPT_PASSWORD, address.password.c_str());
}

void configure(CURL* transfer, const RemoteFiles::Limits& limits, Sink& sink, char* words)
{
    curl_easy_setopt(transfer, CURLOPT_NOSIGNAL, 1L);
    curl_easy_setopt(transfer, CURLOPT_FAILONERROR, 1L);
    curl_easy_setopt(transfer, CURLOPT_CONNECTTIMEOUT_MS, static_cast<long>(limits.connecting.count()));
    curl_easy_setopt(transfer, CURLOPT_TIMEOUT_MS, static_cast<long>(limits.whole.count()));
    curl_easy_setopt(transfer, CURLOPT_MAXFILESIZE_LARGE, static_cast<curl_off_t>(limits.bytes));
    curl_easy_setopt(transfer, CURLOPT_ERRORBUFFER, words);
    curl_easy_setopt(transfer, CURLOPT_WRITEFUNCTION, receive);
    curl_easy_setopt(transfer, CURLOPT_WRITEDATA, &sink);
    curl_easy_setopt(transfer, CURLOPT_NOPROGRESS, 0L);
    curl_easy_setopt(transfer, CURLOPT_XFERINFOFUNCTION, onProgress);
    curl_easy_setopt(transfer, CURLOPT_XFERINFODATA, &sink);
    curl_easy_setopt(transfer, CURLOPT_PREREQFUNCTION, beforeRequest);
    curl_easy_setopt(transfer, CURLOPT_PREREQDATA, &sink);
}

// What stopped the transfer on this side; nothing when the other one did, or nobody.
Result<> ownOutcome(CURLcode status, const Sink& sink)
{
    if (sink.stopped)
        return Failure{translated(L"it was interrupted")};
    if (sink.ledAstray)
        return Failure{translated(L"the server leads from https to http")};
    if (sink.isFull() || status == CURLE_FILESIZE_EXCEEDED)
        return Failure{translated(L"it is larger than {}", sizeInWords(sink.limit))};
    return sink.written ? Result<>() : Failure{translated(L"the local copy could not be written")};
}

Result<> outcomeOf(CURLcode status, const Sink& sink, const char* words)
{
    if (auto own = ownOutcome(status, sink); !own)
        return own;
    if (status != CURLE_OK)
        return Failure{toWide(*words ? words : curl_easy_strerror(status))};
    long answer = 0;
    curl_easy_getinfo(sink.transfer, CURLINFO_RESPONSE_CODE, &answer);
    if (answer != kWholeFile)
        return Failure{translated(L"the server answered {}", answer)};
    return {};
}
} // namespace

Result<std::string> download(const RemoteAddress& address, PartFile& file, const RemoteFiles::Limits& limits,
                             Interruption& interruption, const std::function<void(std::uint64_t)>& tell)
{
    const Transfer transfer(curl_easy_init());
    if (!transfer)
        return Failure{translated(L"the network library cannot be started")};
    char words[CURL_ERROR_SIZE] = "";
    Sink sink(file, limits.bytes, interruption, tell);
    sink.transfer = transfer.get();
    configureAddress(transfer.get(), address);
    configureTrust(transfer.get());
    configure(transfer.get(), limits, sink, words);
    const auto outcome = outcomeOf(curl_easy_perform(transfer.get()), sink, words);
    if (sink.stopped)
        interruption.settle();
    return outcome ? Result<std::string>(sink.sha256.finish()) : outcome.failure();
}
} // namespace tessel
