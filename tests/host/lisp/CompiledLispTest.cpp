#include <gmock/gmock.h>

#include <cstdint>

#include "host/lisp/CompiledLisp.h"

using tessel::packCompiledLisp;
using tessel::unpackCompiledLisp;

namespace
{
constexpr std::size_t kChecksumAt = 20;
constexpr std::size_t kByteCodeAt = 24;

// CRC-32, bit by bit, of everything between the mark at the front and the byte code's end, itself left out.
std::uint32_t checksumOf(const std::string& compiled)
{
    std::uint32_t rest = 0xFFFFFFFF;
    for (const char byte : compiled.substr(8, kChecksumAt - 8) + compiled.substr(kByteCodeAt))
    {
        rest ^= static_cast<unsigned char>(byte);
        for (int bit = 0; bit < 8; ++bit)
            rest = (rest >> 1) ^ ((rest & 1) != 0 ? 0xEDB88320 : 0);
    }
    return ~rest;
}
} // namespace

// Files that somebody has compiled must stay good.
TEST(CompiledLisp, HasTheChecksumThatItAlwaysHad)
{
    const std::string compiled = packCompiledLisp("(1 . code)\xFF\x80");
    std::uint32_t stored = 0;
    for (std::size_t byte = 0; byte < 4; ++byte)
        stored |= std::uint32_t{static_cast<unsigned char>(compiled.at(kChecksumAt + byte))} << (8 * byte);
    EXPECT_EQ(stored, checksumOf(compiled));
}

TEST(CompiledLisp, ComesOutAsItWentIn)
{
    for (const std::string& byteCode : {std::string(), std::string("(1 . code)"), std::string(100000, '\0')})
    {
        const std::string bytes = packCompiledLisp(byteCode);
        const auto unpacked = unpackCompiledLisp(bytes);
        ASSERT_TRUE(unpacked);
        EXPECT_EQ(*unpacked, byteCode);
    }
}

TEST(CompiledLisp, IsRefusedWithAnyByteChangedInAnyBit)
{
    const std::string whole = packCompiledLisp("(1 . code)\n(2 . code)\n");
    for (std::size_t at = 0; at < whole.size(); ++at)
        for (int bit = 0; bit < 8; ++bit)
        {
            std::string damaged = whole;
            damaged[at] = static_cast<char>(damaged[at] ^ (1 << bit));
            const auto unpacked = unpackCompiledLisp(damaged);
            EXPECT_FALSE(unpacked) << at << " " << bit;
            EXPECT_FALSE(unpacked.sentence().empty());
        }
}

TEST(CompiledLisp, IsRefusedAtAnyOtherLength)
{
    const std::string whole = packCompiledLisp("(1 . code)\n(2 . code)\n");
    for (std::size_t length = 0; length < whole.size(); ++length)
        EXPECT_FALSE(unpackCompiledLisp(std::string_view(whole).substr(0, length))) << length;
    EXPECT_FALSE(unpackCompiledLisp(whole + "x"));
}

TEST(CompiledLisp, TellsWhatIsWrong)
{
    const std::string whole = packCompiledLisp("(1 . code)");
    EXPECT_EQ(unpackCompiledLisp("(defun a () 1)").sentence(), L"it is not compiled Lisp");
    EXPECT_EQ(unpackCompiledLisp(std::string_view(whole).substr(0, whole.size() - 1)).sentence(),
              L"it is cut short");
    EXPECT_EQ(unpackCompiledLisp(whole + "x").sentence(), L"it is damaged");
    std::string other = whole;
    other[8] = 99;
    EXPECT_EQ(unpackCompiledLisp(other).sentence(),
              L"it was compiled for another version of Lisp; compile it again");
}
