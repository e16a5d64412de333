// The address of a remote file, taken apart.
#pragma once

#include <string>
#include <string_view>

#include "host/text/Result.h"

namespace tessel
{
// Stands beside a copy and says where it came from; no copy is called so.
inline constexpr const char* kOriginFile = ".url";

struct RemoteAddress
{
    std::string url; // without a name and a password: what is sent, shown and stored
    std::string user;
    std::string password;
    std::string sha256; // what the file is to have, in small letters; empty when any will do

    bool hasCredentials() const { return !user.empty() || !password.empty(); }
};

// The fragment of an address may ask for a checksum: #sha256=<64 hexadecimal digits>, alone or beside other
// parts after an `&`. One that cannot be checked is a failure, and never passed over; why is the end of a
// sentence.
Result<RemoteAddress> parseRemoteAddress(const std::string& text);

// The address without name and password, whatever else may be wrong with it.
std::string withoutUserInfo(const std::string& text);

// Whether what is sent to it cannot be read on the way.
bool isSecure(std::string_view url);

// What a copy of it is called: the last part of the URL's path, without what cannot be a file's name.
std::string fileNameOf(const std::string& url);
} // namespace tessel
