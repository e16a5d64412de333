#include "host/files/Sha256.h"

#include <algorithm>
#include <bit>

namespace tessel
{
namespace
{
constexpr std::size_t kLengthSize = 8; // of the number of bits that ends the last block

constexpr std::array<std::uint32_t, 64> kConstants = {
    0x428a2f98, 0x71374491, 0xb5c0fbcf, 0xe9b5dba5, 0x3956c25b, 0x59f111f1, 0x923f82a4, 0xab1c5ed5,
    0xd807aa98, 0x12835b01, 0x243185be, 0x550c7dc3, 0x72be5d74, 0x80deb1fe, 0x9bdc06a7, 0xc19bf174,
    0xe49b69c1, 0xefbe4786, 0x0fc19dc6, 0x240ca1cc, 0x2de92c6f, 0x4a7484aa, 0x5cb0a9dc, 0x76f988da,
    0x983e5152, 0xa831c66d, 0xb00327c8, 0xbf597fc7, 0xc6e00bf3, 0xd5a79147, 0x06ca6351, 0x14292967,
    0x27b70a85, 0x2e1b2138, 0x4d2c6dfc, 0x53380d13, 0x650a7354, 0x766a0abb, 0x81c2c92e, 0x92722c85,
    0xa2bfe8a1, 0xa81a664b, 0xc24b8b70, 0xc76c51a3, 0xd192e819, 0xd6990624, 0xf40e3585, 0x106aa070,
    0x19a4c116, 0x1e376c08, 0x2748774c, 0x34b0bcb5, 0x391c0cb3, 0x4ed8aa4a, 0x5b9cca4f, 0x682e6ff3,
    0x748f82ee, 0x78a5636f, 0x84c87814, 0x8cc70208, 0x90befffa, 0xa4506ceb, 0xbef9a3f7, 0xc67178f2};

using Words = std::array<std::uint32_t, 64>;

Words wordsOf(const std::array<std::uint8_t, 64>& block)
{
    Words words = {};
    for (std::size_t i = 0; i < block.size(); ++i)
        words[i / 4] = words[i / 4] << 8 | block[i];
    for (std::size_t i = 16; i < words.size(); ++i)
    {
        const std::uint32_t a = words[i - 15];
        const std::uint32_t b = words[i - 2];
        const std::uint32_t s0 = std::rotr(a, 7) ^ std::rotr(a, 18) ^ a >> 3;
        const std::uint32_t s1 = std::rotr(b, 17) ^ std::rotr(b, 19) ^ b >> 10;
        words[i] = words[i - 16] + s0 + words[i - 7] + s1;
    }
    return words;
}
} // namespace

void Sha256::takeBlock()
{
    const Words words = wordsOf(mBlock);
    auto [a, b, c, d, e, f, g, h] = mState;
    for (std::size_t i = 0; i < words.size(); ++i)
    {
        const std::uint32_t s1 = std::rotr(e, 6) ^ std::rotr(e, 11) ^ std::rotr(e, 25);
        const std::uint32_t first = h + s1 + ((e & f) ^ (~e & g)) + kConstants[i] + words[i];
        const std::uint32_t s0 = std::rotr(a, 2) ^ std::rotr(a, 13) ^ std::rotr(a, 22);
        const std::uint32_t second = s0 + ((a & b) ^ (a & c) ^ (b & c));
        h = g, g = f, f = e, e = d + first;
        d = c, c = b, b = a, a = first + second;
    }
    const std::array<std::uint32_t, 8> added = {a, b, c, d, e, f, g, h};
    std::ranges::transform(mState, added, mState.begin(), std::plus());
    mInBlock = 0;
}

void Sha256::add(std::string_view bytes)
{
    mSize += bytes.size();
    for (const char byte : bytes)
    {
        mBlock[mInBlock++] = static_cast<std::uint8_t>(byte);
        if (mInBlock == kBlockSize)
            takeBlock();
    }
}

std::string Sha256::finish()
{
    const std::uint64_t bits = mSize * 8;
    add("\x80");
    while (mInBlock != kBlockSize - kLengthSize)
        add(std::string_view("\0", 1));
    for (int shift = 56; shift >= 0; shift -= 8)
    {
        const char byte = static_cast<char>(bits >> shift);
        add({&byte, 1});
    }
    std::string digits;
    for (const std::uint32_t word : mState)
        for (int shift = 28; shift >= 0; shift -= 4)
            digits += "0123456789abcdef"[word >> shift & 0xF];
    return digits;
}
} // namespace tessel
