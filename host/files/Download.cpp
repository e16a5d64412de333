#include "host/files/Download.h"

#include <curl/curl.h>
#include <unistd.h>

#include <cerrno>
#include <fstream>
#include <memory>
#include <system_error>

#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr const char* kProtocols = "http,https"; // for redirections too: a server must not name local files
constexpr long kMostRedirections = 5;
constexpr long kWholeFile = 200; // of the other answers none brings the file that was asked for

struct Sink
{
    std::ofstream file;
    std::uint64_t received = 0;
    std::uint64_t limit = 0;

    bool isFull() const { return received > limit; }
};

// A body sent in chunks does not say its length before, so that the bytes are counted as they come.
std::size_t receive(char* bytes, std::size_t size, std::size_t count, void* context)
{
    auto& sink = *static_cast<Sink*>(context);
    sink.received += size * count;
    if (sink.isFull())
        return 0;
    sink.file.write(bytes, static_cast<std::streamsize>(size * count));
    return sink.file ? size * count : 0;
}

struct EndTransfer
{
    void operator()(CURL* transfer) const { curl_easy_cleanup(transfer); }
};
using Transfer = std::unique_ptr<CURL, EndTransfer>;

void configure(CURL* transfer, const std::string& url, const RemoteFiles::Limits& limits, Sink& sink,
               char* words)
{
    curl_easy_setopt(transfer, CURLOPT_URL, url.c_str());
    curl_easy_setopt(transfer, CURLOPT_NOSIGNAL, 1L);
    curl_easy_setopt(transfer, CURLOPT_PROTOCOLS_STR, kProtocols);
    curl_easy_setopt(transfer, CURLOPT_REDIR_PROTOCOLS_STR, kProtocols);
    curl_easy_setopt(transfer, CURLOPT_FOLLOWLOCATION, 1L);
    curl_easy_setopt(transfer, CURLOPT_MAXREDIRS, kMostRedirections);
    curl_easy_setopt(transfer, CURLOPT_FAILONERROR, 1L);
    curl_easy_setopt(transfer, CURLOPT_CONNECTTIMEOUT_MS, static_cast<long>(limits.connecting.count()));
    curl_easy_setopt(transfer, CURLOPT_TIMEOUT_MS, static_cast<long>(limits.whole.count()));
    curl_easy_setopt(transfer, CURLOPT_MAXFILESIZE_LARGE, static_cast<curl_off_t>(limits.bytes));
    curl_easy_setopt(transfer, CURLOPT_ERRORBUFFER, words);
    curl_easy_setopt(transfer, CURLOPT_WRITEFUNCTION, receive);
    curl_easy_setopt(transfer, CURLOPT_WRITEDATA, &sink);
}

Failure notMade(const std::filesystem::path& file, const std::string& reason)
{
    return {toWide("the local copy " + file.string() + " cannot be made: " + reason)};
}

Result<> outcomeOf(CURL* transfer, CURLcode status, const Sink& sink, const char* words)
{
    if (sink.isFull() || status == CURLE_FILESIZE_EXCEEDED)
        return Failure{L"it is larger than " + std::to_wstring(sink.limit) + L" bytes"};
    if (!sink.file)
        return Failure{L"the local copy could not be written"};
    if (status != CURLE_OK)
        return Failure{toWide(*words ? words : curl_easy_strerror(status))};
    long answer = 0;
    curl_easy_getinfo(transfer, CURLINFO_RESPONSE_CODE, &answer);
    if (answer != kWholeFile)
        return Failure{L"the server answered " + std::to_wstring(answer)};
    return {};
}

Result<> transferInto(const std::string& url, const std::filesystem::path& part,
                      const RemoteFiles::Limits& limits)
{
    Sink sink{std::ofstream(part, std::ios::binary), 0, limits.bytes};
    if (!sink.file)
        return notMade(part, std::generic_category().message(errno));
    const Transfer transfer(curl_easy_init());
    if (!transfer)
        return Failure{L"the network library cannot be started"};
    char words[CURL_ERROR_SIZE] = "";
    configure(transfer.get(), url, limits, sink, words);
    const CURLcode status = curl_easy_perform(transfer.get());
    sink.file.close();
    return outcomeOf(transfer.get(), status, sink, words);
}
} // namespace

Result<> download(const std::string& url, const std::filesystem::path& file,
                  const RemoteFiles::Limits& limits)
{
    // Named after the process: another one may be fetching the same file.
    const std::filesystem::path part = file.parent_path() / (".part-" + std::to_string(getpid()));
    Result<> done = transferInto(url, part, limits);
    std::error_code failed;
    if (done)
        std::filesystem::rename(part, file, failed);
    if (failed)
        done = notMade(file, failed.message());
    if (!done)
        std::filesystem::remove(part, failed); // may never have come into being
    return done;
}
} // namespace tessel
