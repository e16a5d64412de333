// One download, with limits.
#pragma once

#include <cstdint>
#include <functional>
#include <string>

#include "host/files/RemoteFiles.h"
#include "host/text/Result.h"

namespace tessel
{
class PartFile;

// Fetches what stands at the address into the file; answers its SHA-256. Ends early when the key is pressed
// or the session is to end. Why it failed is the end of a sentence. `tell` is called with the bytes so far
// whenever a person has waited for a word.
Result<std::string> download(const RemoteAddress& address, PartFile& file, const RemoteFiles::Limits& limits,
                             Interruption& interruption, const std::function<void(std::uint64_t)>& tell);
} // namespace tessel
