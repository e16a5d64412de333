#include "host/files/network/Sha256.h"

#include <array>
#include <new>

#include "host/text/Hexadecimal.h"

namespace tessel
{
namespace
{
// The library fails for want of memory alone: its parameters are right.
void expect(int succeeded)
{
    if (succeeded != 1)
        throw std::bad_alloc();
}
} // namespace

Sha256::Sha256() : mContext(EVP_MD_CTX_new())
{
    expect(mContext != nullptr);
    expect(EVP_DigestInit_ex(mContext.get(), EVP_sha256(), nullptr));
}

void Sha256::add(std::string_view bytes)
{
    expect(EVP_DigestUpdate(mContext.get(), bytes.data(), bytes.size()));
}

std::string Sha256::finish()
{
    std::array<unsigned char, EVP_MAX_MD_SIZE> digest = {};
    unsigned length = 0;
    expect(EVP_DigestFinal_ex(mContext.get(), digest.data(), &length));
    std::string digits;
    for (unsigned i = 0; i < length; ++i)
        digits += hexadecimal<char>(digest[i], kSmallHexDigits);
    return digits;
}
} // namespace tessel
