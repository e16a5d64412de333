#include "host/lisp/CompiledLisp.h"

#include <cstdint>

#include <ecl/ecl.h>
#include <libdeflate.h>

#include "host/text/Translation.h"

namespace tessel
{
namespace
{
// The line ends show a transfer that has changed them; the first byte keeps tools from taking it for text.
constexpr std::string_view kSignature = "\x89QBC\r\n\x1A\n";
constexpr std::uint32_t kFormatVersion = 1;
// Byte code is that of one version of ECL.
constexpr std::uint32_t kLispVersion = ECL_VERSION_NUMBER;

constexpr std::size_t kNumberSize = 4;
// After the magic: format version, Lisp version, length of the byte code, checksum of all that and the byte
// code.
constexpr std::size_t kLispVersionAt = kNumberSize;
constexpr std::size_t kLengthAt = 2 * kNumberSize;
constexpr std::size_t kChecksumAt = 3 * kNumberSize;
constexpr std::size_t kNumbersSize = 4 * kNumberSize;

std::uint32_t addToChecksum(std::uint32_t checksum, std::string_view bytes)
{
    return libdeflate_crc32(checksum, bytes.data(), bytes.size());
}

void appendNumber(std::string& bytes, std::uint32_t number)
{
    for (std::size_t index = 0; index < kNumberSize; ++index)
        bytes += static_cast<char>(number >> (8 * index));
}

std::uint32_t numberAt(std::string_view bytes, std::size_t at)
{
    std::uint32_t number = 0;
    for (std::size_t index = 0; index < kNumberSize; ++index)
        number |= static_cast<std::uint32_t>(static_cast<unsigned char>(bytes[at + index])) << (8 * index);
    return number;
}

std::uint32_t checksumOf(std::string_view numbers, std::string_view byteCode)
{
    return addToChecksum(addToChecksum(0, numbers.substr(0, kChecksumAt)), byteCode);
}
} // namespace

std::string packCompiledLisp(std::string_view byteCode)
{
    std::string numbers;
    appendNumber(numbers, kFormatVersion);
    appendNumber(numbers, kLispVersion);
    appendNumber(numbers, static_cast<std::uint32_t>(byteCode.size()));
    appendNumber(numbers, checksumOf(numbers, byteCode));
    return std::string(kSignature) + numbers + std::string(byteCode);
}

Result<std::string_view> unpackCompiledLisp(std::string_view bytes)
{
    if (!bytes.starts_with(kSignature))
        return Failure{translated(L"it is not compiled Lisp")};
    bytes.remove_prefix(kSignature.size());
    if (bytes.size() < kNumbersSize)
        return Failure{translated(L"it is cut short")};
    const auto numbers = bytes.substr(0, kNumbersSize);
    const auto byteCode = bytes.substr(kNumbersSize);
    if (numberAt(numbers, 0) != kFormatVersion || numberAt(numbers, kLispVersionAt) != kLispVersion)
        return Failure{translated(L"it was compiled for another version of Lisp; compile it again")};
    if (byteCode.size() < numberAt(numbers, kLengthAt))
        return Failure{translated(L"it is cut short")};
    if (byteCode.size() > numberAt(numbers, kLengthAt) ||
        checksumOf(numbers, byteCode) != numberAt(numbers, kChecksumAt))
        return Failure{translated(L"it is damaged")};
    return byteCode;
}
} // namespace tessel
