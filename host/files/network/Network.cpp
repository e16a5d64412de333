#include "host/files/network/Network.h"

#include <curl/curl.h>

#include <cstdlib>
#include <string_view>

#include <tessel/tsdefs.h>

#include "host/files/network/Sha256.h"

namespace tessel
{
namespace
{
constexpr const char* kProtocols = "http,https"; // for redirections too: a server must not name local files
constexpr long kMostRedirections = 5;

struct EndTransfer
{
    void operator()(CURL* transfer) const { curl_easy_cleanup(transfer); }
};
using Transfer = std::unique_ptr<CURL, EndTransfer>;

TransferWatch& watchIn(void* context)
{
    return *static_cast<TransferWatch*>(context);
}

std::size_t receive(char* bytes, std::size_t size, std::size_t count, void* context)
{
    return watchIn(context).receive({bytes, size * count}) ? size * count : 0;
}

int onProgress(void* context, curl_off_t, curl_off_t, curl_off_t, curl_off_t)
{
    return watchIn(context).goesOn() ? 0 : 1;
}

struct Request
{
    CURL* transfer;
    TransferWatch& watch;
};

int beforeRequest(void* context, char*, char*, int, int)
{
    const auto& request = *static_cast<const Request*>(context);
    const char* url = nullptr;
    curl_easy_getinfo(request.transfer, CURLINFO_EFFECTIVE_URL, &url);
    return request.watch.mayAsk(url ? url : "") ? CURL_PREREQFUNC_OK : CURL_PREREQFUNC_ABORT;
}

// Whom to trust is the system's to know, or that of the person who has a certificate of their own.
void configureTrust(CURL* transfer)
{
    if (const char* certificates = std::getenv("SSL_CERT_FILE"); certificates && *certificates)
        curl_easy_setopt(transfer, CURLOPT_CAINFO, certificates);
}

void configureAddress(CURL* transfer, const TransferOrder& order)
{
    curl_easy_setopt(transfer, CURLOPT_URL, order.url.c_str());
    curl_easy_setopt(transfer, CURLOPT_PROTOCOLS_STR, kProtocols);
    curl_easy_setopt(transfer, CURLOPT_REDIR_PROTOCOLS_STR, kProtocols);
    curl_easy_setopt(transfer, CURLOPT_FOLLOWLOCATION, 1L);
    curl_easy_setopt(transfer, CURLOPT_MAXREDIRS, kMostRedirections);
    if (order.user.empty() && order.password.empty())
        return;
    curl_easy_setopt(transfer, CURLOPT_USERNAME, order.user.c_str());
    curl_easy_setopt(transfer, CURLOPT_PASSWORD, order.password.c_str());
}

void configureLimits(CURL* transfer, const TransferOrder& order)
{
    curl_easy_setopt(transfer, CURLOPT_NOSIGNAL, 1L);
    curl_easy_setopt(transfer, CURLOPT_FAILONERROR, 1L);
    curl_easy_setopt(transfer, CURLOPT_CONNECTTIMEOUT_MS, static_cast<long>(order.connecting.count()));
    curl_easy_setopt(transfer, CURLOPT_TIMEOUT_MS, static_cast<long>(order.whole.count()));
    curl_easy_setopt(transfer, CURLOPT_MAXFILESIZE_LARGE, static_cast<curl_off_t>(order.mostBytes));
}

void configureWatch(Request& request)
{
    curl_easy_setopt(request.transfer, CURLOPT_WRITEFUNCTION, receive);
    curl_easy_setopt(request.transfer, CURLOPT_WRITEDATA, &request.watch);
    curl_easy_setopt(request.transfer, CURLOPT_NOPROGRESS, 0L);
    curl_easy_setopt(request.transfer, CURLOPT_XFERINFOFUNCTION, onProgress);
    curl_easy_setopt(request.transfer, CURLOPT_XFERINFODATA, &request.watch);
    curl_easy_setopt(request.transfer, CURLOPT_PREREQFUNCTION, beforeRequest);
    curl_easy_setopt(request.transfer, CURLOPT_PREREQDATA, &request);
}

TransferResult resultOf(CURL* transfer, CURLcode status, const char* words)
{
    if (status == CURLE_FILESIZE_EXCEEDED)
        return {TransferEnd::kTooLarge, {}, 0};
    if (status != CURLE_OK)
        return {TransferEnd::kFailed, *words ? words : curl_easy_strerror(status), 0};
    TransferResult result{TransferEnd::kAnswered, {}, 0};
    curl_easy_getinfo(transfer, CURLINFO_RESPONSE_CODE, &result.answer);
    return result;
}

class CurlNetwork final : public Network
{
public:
    TransferResult transfer(const TransferOrder& order, TransferWatch& watch) override
    {
        const Transfer transfer(curl_easy_init());
        if (!transfer)
            return {};
        char words[CURL_ERROR_SIZE] = "";
        curl_easy_setopt(transfer.get(), CURLOPT_ERRORBUFFER, words);
        Request request{transfer.get(), watch};
        configureAddress(transfer.get(), order);
        configureTrust(transfer.get());
        configureLimits(transfer.get(), order);
        configureWatch(request);
        return resultOf(transfer.get(), curl_easy_perform(transfer.get()), words);
    }

    std::unique_ptr<Checksum> checksum() override { return std::make_unique<Sha256>(); }
};
} // namespace
} // namespace tessel

// Null for a host of another version, which may know these classes with other members.
extern "C" TESSEL_EXPORT tessel::Network* tesselNetwork(const char* versionOfHost)
{
    static tessel::CurlNetwork network;
    return std::string_view(versionOfHost) == TESSEL_VERSION ? &network : nullptr;
}
