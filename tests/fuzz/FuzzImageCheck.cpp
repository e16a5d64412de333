// The check of a shared library's headers, fed with any headers: it reads only what is there, and what it
// lets pass lies in the file.
#include <cstdint>
#include <cstdlib>
#include <cstring>

#include <elf.h>

#include "host/applications/SdkVersion.h"

namespace
{
// The file goes on after the bytes of the fuzzer, so that not every header points past its end.
constexpr std::uint64_t kFileSize = 1 << 20;

bool liesInFile(const Elf64_Phdr& segment)
{
    return segment.p_filesz <= kFileSize && segment.p_offset <= kFileSize - segment.p_filesz;
}
} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    const auto readAt = [&](std::uint64_t offset, void* buffer, std::size_t wanted)
    {
        if (wanted > size || offset > size - wanted)
            return false;
        std::memcpy(buffer, data + offset, wanted);
        return true;
    };
    if (!tessel::checkMappable(kFileSize, readAt))
        return 0;
    static_cast<void>(tessel::sdkVersionIn(kFileSize, readAt)); // ends, and reads what is there
    Elf64_Ehdr header;
    if (!readAt(0, &header, sizeof header))
        std::abort();
    for (unsigned i = 0; i < header.e_phnum; ++i)
    {
        Elf64_Phdr segment;
        if (!readAt(header.e_phoff + i * sizeof segment, &segment, sizeof segment))
            std::abort();
        if (segment.p_type == PT_LOAD && !liesInFile(segment))
            std::abort();
    }
    return 0;
}
