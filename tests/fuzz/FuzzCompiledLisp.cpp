// Files of compiled Lisp: any bytes are refused with a reason, or are what would be written for their byte
// code; and one bit that is changed is noticed.
#include <cstdint>
#include <cstdlib>
#include <string>

#include "host/lisp/CompiledLisp.h"

namespace
{
void require(bool condition)
{
    if (!condition)
        std::abort();
}
} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    const std::string bytes(data, data + size);
    const auto unpacked = tessel::unpackCompiledLisp(bytes);
    require(unpacked ? tessel::packCompiledLisp(*unpacked) == bytes : !unpacked.sentence().empty());
    std::string packed = tessel::packCompiledLisp(bytes);
    const auto same = tessel::unpackCompiledLisp(packed);
    require(same && *same == bytes);
    const std::size_t place = size > 1 ? (data[0] << 8 | data[1]) % packed.size() : 0;
    packed[place] = static_cast<char>(packed[place] ^ (1 << (size > 2 ? data[2] % 8 : 0)));
    require(!tessel::unpackCompiledLisp(packed));
    return 0;
}
