// The check of a shared library's headers for Mach-O, fed with any headers: it reads only what is there, and
// what it lets pass is a library for this processor that lies in the file.
#include <cstdint>
#include <cstdlib>
#include <cstring>

#include <mach-o/loader.h>

#include "host/applications/SdkVersion.h"

namespace
{
// The file goes on after the bytes of the fuzzer, so that not every image reaches beyond its end.
constexpr std::uint64_t kFileSize = 1 << 20;

bool isLibrary(const mach_header_64& header)
{
    return header.magic == MH_MAGIC_64 && header.cputype == CPU_TYPE_X86_64 &&
           (header.filetype == MH_BUNDLE || header.filetype == MH_DYLIB) && header.sizeofcmds <= kFileSize;
}
} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    mach_header_64 last = {}; // what was read last of a header's size
    const auto readAt = [&](std::uint64_t offset, void* buffer, std::size_t wanted)
    {
        if (wanted > size || offset > size - wanted)
            return false;
        std::memcpy(buffer, data + offset, wanted);
        if (wanted == sizeof last)
            std::memcpy(&last, buffer, wanted);
        return true;
    };
    const auto checked = tessel::checkMappable(kFileSize, readAt);
    if (checked ? !isLibrary(last) : checked.sentence().empty())
        std::abort();
    static_cast<void>(tessel::sdkVersionIn(kFileSize, readAt)); // ends, and reads what is there
    return 0;
}
