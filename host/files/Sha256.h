// The SHA-256 of bytes (FIPS 180-4).
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

namespace tessel
{
class Sha256
{
public:
    void add(std::string_view bytes);

    // 64 hexadecimal digits in small letters; nothing can be added after it.
    std::string finish();

private:
    static constexpr std::size_t kBlockSize = 64;

    void takeBlock();

    std::array<std::uint32_t, 8> mState = {0x6a09e667, 0xbb67ae85, 0x3c6ef372, 0xa54ff53a,
                                           0x510e527f, 0x9b05688c, 0x1f83d9ab, 0x5be0cd19};
    std::array<std::uint8_t, kBlockSize> mBlock = {};
    std::size_t mInBlock = 0;
    std::uint64_t mSize = 0; // in bytes
};
} // namespace tessel
