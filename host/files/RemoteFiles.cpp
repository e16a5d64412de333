#include "host/files/RemoteFiles.h"

#include <tessel/tsdefs.h>
#include <unicode/utf8.h>

#include <algorithm>
#include <cstdint>
#include <cwchar>
#include <fstream>
#include <iterator>
#include <optional>
#include <system_error>

#include "host/files/Download.h"
#include "host/text/Running.h"
#include "host/text/Unicode.h"

// The cache holds one folder per URL, named by its hash: the copy under the file's own name, so that its
// extension still tells its kind, and beside it the URL.
namespace tessel
{
namespace
{
constexpr const char* kOriginFile = ".url";
constexpr const char* kUnnamedFile = "download";
constexpr std::size_t kLongestFileName = 200; // in bytes; a file system takes 255

// FNV-1a; the URL beside the copy tells two with the same hash apart.
std::uint64_t hashOf(const std::string& text)
{
    std::uint64_t hash = 14695981039346656037ull;
    for (const char character : text)
        hash = (hash ^ static_cast<unsigned char>(character)) * 1099511628211ull;
    return hash;
}

// The first byte at or after the position that begins a character.
std::size_t firstCharacter(const std::string& utf8, std::size_t position)
{
    while (position < utf8.size() && U8_IS_TRAIL(static_cast<std::uint8_t>(utf8[position])))
        ++position;
    return position;
}

// The last part of the URL's path, without what cannot be a file's name.
std::string fileNameOf(const std::string& url)
{
    std::string path = url.substr(0, url.find_first_of("?#"));
    const std::size_t host = path.find("://") + 3;
    const std::size_t slash = path.rfind('/');
    std::string name = slash == std::string::npos || slash < host ? "" : path.substr(slash + 1);
    std::replace(name.begin(), name.end(), '\\', '_');
    if (name.size() > kLongestFileName) // the end tells the kind
        name.erase(0, firstCharacter(name, name.size() - kLongestFileName));
    const bool unusable = name.empty() || name == "." || name == ".." || name == kOriginFile;
    return unusable ? kUnnamedFile : name;
}

std::string readFile(const std::filesystem::path& file)
{
    std::ifstream stream(file, std::ios::binary);
    return {std::istreambuf_iterator<char>(stream), {}};
}

bool writeFile(const std::filesystem::path& file, const std::string& text)
{
    std::ofstream stream(file, std::ios::binary);
    stream << text;
    stream.close();
    return stream.good();
}

bool isFile(const std::filesystem::path& file)
{
    std::error_code unreachable;
    return std::filesystem::is_regular_file(file, unreachable);
}

std::filesystem::path resolved(const std::filesystem::path& path)
{
    std::error_code unreachable;
    return std::filesystem::weakly_canonical(path, unreachable);
}

Failure notFetched(const std::wstring& url, const std::wstring& reason)
{
    return {url + L" could not be fetched: " + reason + L".", TS_FETCH_FAILED};
}
} // namespace

RemoteFiles::RemoteFiles(std::filesystem::path cacheFolder, Limits limits)
    : mCacheFolder(std::move(cacheFolder)), mLimits(limits)
{
}

std::filesystem::path RemoteFiles::copyOf(const std::string& url) const
{
    return mCacheFolder / std::to_string(hashOf(url)) / fileNameOf(url);
}

Result<RemoteFiles::Copy> RemoteFiles::fetch(const std::wstring& url, std::size_t longestPath,
                                             bool ignoreCache)
{
    const std::string address = toUtf8(url);
    const std::filesystem::path copy = copyOf(address);
    const std::wstring path = toWide(copy.string());
    if (path.size() > longestPath)
        return notFetched(url, L"the path of its local copy has more than " + std::to_wstring(longestPath) +
                                   L" characters");
    if (!ignoreCache && isFile(copy) && readFile(copy.parent_path() / kOriginFile) == address)
        return Copy{TS_FROM_CACHE, path};
    if (const auto fetched = fetchInto(copy, address); !fetched)
        return notFetched(url, fetched.sentence());
    return Copy{TS_FETCHED, path};
}

// What this says of a failure is the end of a sentence.
Result<> RemoteFiles::fetchInto(const std::filesystem::path& copy, const std::string& url) const
{
    const std::filesystem::path folder = copy.parent_path();
    std::error_code failed;
    const bool isNew = std::filesystem::create_directories(folder, failed);
    if (failed)
        return Failure{
            toWide("the cache folder " + folder.string() + " cannot be made: " + failed.message())};
    Result<> fetched = download(url, copy, mLimits);
    // What an earlier fetch wrote stays: a copy without its origin would be lost.
    const bool isKnown = readFile(folder / kOriginFile) == url;
    if (fetched && !isKnown && !writeFile(folder / kOriginFile, url))
        fetched = Failure{toWide("the cache folder " + folder.string() + " cannot be written")};
    if (!fetched && isNew)
        std::filesystem::remove_all(folder, failed);
    return fetched;
}

bool RemoteFiles::IsRemoteFile(const wchar_t* localPath, wchar_t* url, std::size_t capacity) const
{
    const std::filesystem::path file = resolved(toUtf8(localPath ? localPath : L""));
    const std::filesystem::path folder = file.parent_path();
    if (folder.parent_path() != resolved(mCacheFolder) || !isFile(file))
        return false;
    const std::string address = readFile(folder / kOriginFile);
    if (address.empty() || file.filename() != fileNameOf(address))
        return false;
    const std::wstring origin = toWide(address);
    if (url && capacity > 0)
    {
        const std::size_t copied = std::min(origin.size(), capacity - 1);
        std::wmemcpy(url, origin.data(), copied);
        url[copied] = L'\0';
    }
    return true;
}
} // namespace tessel

CProxyInet* CProxyInet::GetProxyInet()
{
    return tessel::running<tessel::RemoteFiles>();
}
