#include "host/files/RemoteAddress.h"

#include <unicode/utf8.h>

#include <algorithm>
#include <cstdint>
#include <optional>

#include "host/text/Translation.h"

namespace tessel
{
namespace
{
constexpr std::string_view kMark = "://";
constexpr std::string_view kSecureScheme = "https";
constexpr std::string_view kChecksum = "sha256=";
constexpr std::size_t kChecksumDigits = 64;
constexpr const char* kUnnamedFile = "download";
constexpr std::size_t kLongestFileName = 200; // in bytes; a file system takes 255

char lower(char character)
{
    return character >= 'A' && character <= 'Z' ? static_cast<char>(character - 'A' + 'a') : character;
}

std::string lower(std::string_view text)
{
    std::string result(text);
    std::ranges::transform(result, result.begin(), [](char character) { return lower(character); });
    return result;
}

std::optional<unsigned> hexDigit(char digit)
{
    const std::size_t value = std::string_view("0123456789abcdef").find(lower(digit));
    return value == std::string_view::npos ? std::nullopt : std::optional(static_cast<unsigned>(value));
}

// With %41 as A.
std::string decoded(std::string_view text)
{
    std::string result;
    for (std::size_t at = 0; at < text.size(); ++at)
    {
        const bool escaped = text[at] == '%' && text.size() - at > 2;
        const auto high = escaped ? hexDigit(text[at + 1]) : std::nullopt;
        const auto low = escaped ? hexDigit(text[at + 2]) : std::nullopt;
        result += high && low ? static_cast<char>(*high << 4 | *low) : text[at];
        at += high && low ? 2 : 0;
    }
    return result;
}

struct UserInfo
{
    std::size_t begin = 0;
    std::size_t end = 0; // after the @
};

// What stands before the host, if anything does.
UserInfo userInfoIn(std::string_view text)
{
    const std::size_t mark = text.find(kMark);
    if (mark == text.npos)
        return {};
    const std::size_t begin = mark + kMark.size();
    const std::size_t end = std::min(text.find_first_of("/?#", begin), text.size());
    const std::size_t at = text.substr(begin, end - begin).rfind('@');
    return {begin, at == text.npos ? begin : begin + at + 1};
}

// Takes the first of the parts between `&`.
std::string_view takePart(std::string_view& parts)
{
    const std::size_t end = std::min(parts.find('&'), parts.size());
    const std::string_view part = parts.substr(0, end);
    parts.remove_prefix(std::min(end + 1, parts.size()));
    return part;
}

// A person who writes one of these relies on its being checked.
bool isOtherChecksum(const std::string& part)
{
    return part.find('=') != part.npos && (part.starts_with("sha") || part.starts_with("md5"));
}

Result<std::string> checksumIn(std::string_view fragment)
{
    std::string found;
    while (!fragment.empty())
    {
        const std::string part = lower(takePart(fragment));
        if (!part.starts_with(kChecksum) && !isOtherChecksum(part))
            continue;
        const std::string digits = part.starts_with(kChecksum) ? part.substr(kChecksum.size()) : "";
        const bool isChecksum =
            digits.size() == kChecksumDigits &&
            std::ranges::all_of(digits, [](char digit) { return hexDigit(digit).has_value(); });
        if (!isChecksum || (!found.empty() && found != digits))
            return Failure{
                translated(L"the checksum in the address is not one SHA-256 of 64 hexadecimal digits")};
        found = digits;
    }
    return found;
}

// The first byte at or after the position that begins a character.
std::size_t firstCharacter(const std::string& utf8, std::size_t position)
{
    while (position < utf8.size() && U8_IS_TRAIL(static_cast<std::uint8_t>(utf8[position])))
        ++position;
    return position;
}
} // namespace

Result<RemoteAddress> parseRemoteAddress(const std::string& text)
{
    const UserInfo info = userInfoIn(text);
    RemoteAddress address;
    address.url = withoutUserInfo(text);
    if (info.end > info.begin)
    {
        const std::string_view both = std::string_view(text).substr(info.begin, info.end - 1 - info.begin);
        const std::size_t colon = std::min(both.find(':'), both.size());
        address.user = decoded(both.substr(0, colon));
        address.password = decoded(both.substr(std::min(colon + 1, both.size())));
    }
    const std::size_t fragment = std::min(address.url.find('#'), address.url.size() - 1) + 1;
    const auto checksum = checksumIn(std::string_view(address.url).substr(fragment));
    if (!checksum)
        return checksum.failure();
    address.sha256 = *checksum;
    return address;
}

std::string withoutUserInfo(const std::string& text)
{
    const UserInfo info = userInfoIn(text);
    return std::string(text).erase(info.begin, info.end - info.begin);
}

bool isSecure(std::string_view url)
{
    return lower(url.substr(0, url.find(kMark))) == kSecureScheme;
}

std::string fileNameOf(const std::string& url)
{
    const std::string path = url.substr(0, url.find_first_of("?#"));
    const std::size_t mark = path.find(kMark);
    const std::size_t host = mark == path.npos ? 0 : mark + kMark.size();
    const std::size_t slash = path.rfind('/');
    std::string name = slash == path.npos || slash < host ? "" : path.substr(slash + 1);
    std::ranges::replace(name, '\\', '_');
    std::ranges::replace(name, '\0', '_');
    if (name.size() > kLongestFileName) // the end tells the kind
        name.erase(0, firstCharacter(name, name.size() - kLongestFileName));
    const bool unusable = name.empty() || name == "." || name == ".." || name == kOriginFile;
    return unusable ? kUnnamedFile : name;
}
} // namespace tessel
