// Addresses of remote files, and the names of their copies: whatever is written there, no name and password
// stay, no checksum is passed over, and the name is that of a file in its folder.
#include <algorithm>
#include <cstdint>
#include <cstdlib>

#include "host/files/RemoteAddress.h"
#include "host/files/network/Sha256.h"

namespace
{
constexpr std::size_t kChecksumDigits = 64;
constexpr std::size_t kLongestName = 255;

void require(bool condition)
{
    if (!condition)
        std::abort();
}

void checkName(const std::string& name)
{
    require(!name.empty() && name.size() <= kLongestName && name != "." && name != "..");
    require(name.find('/') == name.npos && name.find('\0') == name.npos && name != tessel::kOriginFile);
}

void checkAddress(const tessel::RemoteAddress& address)
{
    require(tessel::withoutUserInfo(address.url) == address.url);
    require(address.sha256.empty() || address.sha256.size() == kChecksumDigits);
    require(address.sha256.find_first_not_of("0123456789abcdef") == std::string::npos);
    const auto again = tessel::parseRemoteAddress(address.url);
    require(again && again->url == address.url && !again->hasCredentials() &&
            again->sha256 == address.sha256);
    static_cast<void>(tessel::isSecure(address.url));
}
} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    const std::string text(data, data + size);
    checkName(tessel::fileNameOf(text));
    const auto address = tessel::parseRemoteAddress(text);
    if (address)
        checkAddress(*address);
    else
        require(!address.sentence().empty() && text.find('#') != text.npos);
    // In pieces of any size the checksum is the same.
    tessel::Sha256 whole;
    whole.add(text);
    tessel::Sha256 pieces;
    pieces.add(std::string_view(text).substr(0, size / 3));
    pieces.add(std::string_view(text).substr(size / 3));
    require(whole.finish() == pieces.finish());
    return 0;
}
