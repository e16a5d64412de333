#include "host/files/RemoteFiles.h"

#include <tessel/tsdefs.h>

#include <cerrno>
#include <cstdint>
#include <system_error>

#include "host/files/Download.h"
#include "host/files/NetworkLibrary.h"
#include "host/files/RemoteAddress.h"
#include "host/files/network/Network.h"
#include "host/platform/OrdinaryFile.h"
#include "host/platform/PartFile.h"
#include "host/platform/PrivateFolder.h"
#include "host/text/CallersBuffer.h"
#include "host/text/Running.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"

// The cache holds one folder per URL, named by its hash: the copy under the file's own name, so that its
// extension still tells its kind, and beside it the URL.
namespace tessel
{
namespace
{
constexpr std::uintmax_t kLongestOrigin = std::uintmax_t{1} << 20; // servers take no longer address

// FNV-1a; the URL beside the copy tells two with the same hash apart.
std::uint64_t hashOf(const std::string& text)
{
    std::uint64_t hash = 14695981039346656037ull;
    for (const char character : text)
        hash = (hash ^ static_cast<unsigned char>(character)) * 1099511628211ull;
    return hash;
}

// Empty when there is nothing that can be read.
std::string originIn(const std::filesystem::path& folder)
{
    const auto origin = readOrdinaryFile(folder / kOriginFile, kLongestOrigin);
    return origin ? *origin : std::string();
}

std::filesystem::path resolved(const std::filesystem::path& path)
{
    std::error_code unreachable;
    return std::filesystem::weakly_canonical(path, unreachable);
}

Failure notFetched(const std::string& address, const std::wstring& reason)
{
    return {translated(L"{} could not be fetched: {}.", toWide(withoutUserInfo(address)), reason),
            TS_FETCH_FAILED};
}

// Hands on what failed with the file or folder, after the words that say with which.
Failure about(Sentence<2> words, const std::filesystem::path& path, const Outcome& failed)
{
    return {translated(words, path, failed.sentence())};
}

constexpr auto kNoFolder = Sentence<2>(L"the cache folder {} cannot be made: {}");
constexpr auto kUnsafeFolder = Sentence<2>(L"the cache folder {} is not safe: {}");
constexpr auto kNoOrigin = Sentence<2>(L"the cache folder {} cannot be written: {}");
constexpr auto kNoLocalCopy = Sentence<2>(L"the local copy {} cannot be made: {}");

// A folder of the cache's own: made where it is missing, and closed to others where an older version has left
// it open.
Result<> prepareFolder(const std::filesystem::path& folder)
{
    if (const auto made = makePrivateFolder(folder); !made)
        return about(kNoFolder, folder, made);
    if (!checkNobodyElseWrites(folder))
    {
        std::error_code notOurs; // is told by the next look
        std::filesystem::permissions(folder, std::filesystem::perms::owner_all, notOurs);
    }
    const auto checked = checkNobodyElseWrites(folder);
    return checked ? checked : about(kUnsafeFolder, folder, checked);
}

Result<> checkContent(const std::string& sha256, const RemoteAddress& address)
{
    if (address.sha256.empty() || sha256 == address.sha256)
        return {};
    return Failure{translated(L"its SHA-256 is {}, not the one that the address asks for", toWide(sha256))};
}

std::string sha256Of(const std::filesystem::path& file, std::uintmax_t mostBytes)
{
    const auto content = readOrdinaryFile(file, mostBytes);
    const auto net = network();
    if (!content || !net)
        return {};
    const auto checksum = (*net)->checksum();
    checksum->add(*content);
    return checksum->finish();
}

// Puts the copy into its place, and its origin beside it.
Result<> store(PartFile& part, const std::filesystem::path& copy, const std::string& url)
{
    const std::filesystem::path folder = copy.parent_path();
    // What an earlier fetch wrote stays: a copy without its origin would be lost.
    const bool isKnown = originIn(folder) == url && checkNobodyElseWrites(folder / kOriginFile);
    if (const auto moved = part.moveTo(copy); !moved)
        return about(kNoLocalCopy, copy, moved);
    const auto noted = isKnown ? Result<>() : replaceFile(folder / kOriginFile, url);
    if (noted)
        return noted;
    std::error_code gone;
    std::filesystem::remove(copy, gone);
    return about(kNoOrigin, folder, noted);
}
} // namespace

RemoteFiles::RemoteFiles(std::filesystem::path cacheFolder, Limits limits, Interruption& interruption,
                         Say say)
    : mCacheFolder(std::move(cacheFolder)), mLimits(limits), mInterruption(interruption), mSay(std::move(say))
{
    PartFile::clearLeftOvers(mCacheFolder);
}

std::filesystem::path RemoteFiles::copyOf(const std::string& url) const
{
    return mCacheFolder / std::to_string(hashOf(url)) / fileNameOf(url);
}

// Another user could have put something else there, if any of these is theirs to write.
bool RemoteFiles::canBeTrusted(const std::filesystem::path& copy) const
{
    const std::filesystem::path folder = copy.parent_path();
    return checkNobodyElseWrites(mCacheFolder) && checkNobodyElseWrites(folder) &&
           checkNobodyElseWrites(copy) && checkNobodyElseWrites(folder / kOriginFile);
}

bool RemoteFiles::hasCopy(const std::filesystem::path& copy, const RemoteAddress& address) const
{
    return isOrdinaryFile(copy) && canBeTrusted(copy) && originIn(copy.parent_path()) == address.url &&
           (address.sha256.empty() || sha256Of(copy, mLimits.bytes) == address.sha256);
}

Result<RemoteFiles::Copy> RemoteFiles::fetch(const std::wstring& url, std::size_t longestPath,
                                             bool ignoreCache)
{
    const std::string text = toUtf8(url);
    const auto address = parseRemoteAddress(text);
    if (!address)
        return notFetched(text, address.sentence());
    const std::filesystem::path copy = copyOf(address->url);
    const std::wstring path = toWide(copy.string());
    if (path.size() > longestPath)
        return notFetched(text, translatedByCount(longestPath,
                                                  L"the path of its local copy has more than {} character",
                                                  L"the path of its local copy has more than {} characters"));
    if (!ignoreCache && !address->hasCredentials() && hasCopy(copy, *address))
        return Copy{TS_FROM_CACHE, path};
    if (const auto fetched = fetchInto(copy, *address); !fetched)
        return notFetched(text, fetched.sentence());
    return Copy{TS_FETCHED, path};
}

// What this says of a failure is the end of a sentence.
Result<> RemoteFiles::fetchInto(const std::filesystem::path& copy, const RemoteAddress& address) const
{
    if (const auto prepared = prepareFolder(mCacheFolder); !prepared)
        return prepared;
    PartFile part(mCacheFolder);
    if (!part.made())
        return about(kNoLocalCopy, copy, part.made());
    const auto tell = [&](std::uint64_t bytes)
    {
        constexpr std::uint64_t kThousand = 1024;
        if (mSay)
            mSay(translated(L"Of {} {} kB have come so far. Ctrl-C stops it.", toWide(address.url),
                            bytes / kThousand));
    };
    const auto sha256 = download(address, part, mLimits, mInterruption, tell);
    if (!sha256)
        return sha256.failure();
    if (const auto checked = checkContent(*sha256, address); !checked)
        return checked;
    const std::filesystem::path folder = copy.parent_path();
    PartFile::clearLeftOvers(folder); // of older versions, which wrote there
    const bool isNew = !std::filesystem::exists(folder);
    auto stored = prepareFolder(folder);
    if (stored)
        stored = store(part, copy, address.url);
    std::error_code gone;
    if (!stored && isNew)
        std::filesystem::remove_all(folder, gone);
    return stored;
}

bool RemoteFiles::IsRemoteFile(const wchar_t* localPath, wchar_t* url, std::size_t capacity) const
{
    const std::filesystem::path file = resolved(toUtf8(localPath ? localPath : L""));
    const std::filesystem::path folder = file.parent_path();
    if (folder.parent_path() != resolved(mCacheFolder) || !isOrdinaryFile(file))
        return false;
    const std::string address = canBeTrusted(file) ? originIn(folder) : std::string();
    if (address.empty() || file.filename() != fileNameOf(address))
        return false;
    copyCut(toWide(address), url, capacity);
    return true;
}
} // namespace tessel

CProxyInet* CProxyInet::GetProxyInet()
{
    return tessel::running<tessel::RemoteFiles>();
}
