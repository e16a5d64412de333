// One download, with limits.
#pragma once

#include <string>

#include "host/files/RemoteFiles.h"
#include "host/text/Result.h"

namespace tessel
{
class PartFile;

// Fetches what stands at the address into the file; answers its SHA-256. Ends early when the key is pressed
// or the session is to end. Why it failed is the end of a sentence.
Result<std::string> download(const RemoteAddress& address, PartFile& file, const RemoteFiles::Limits& limits,
                             Interruption& interruption);
} // namespace tessel
