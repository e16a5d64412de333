// The SHA-256 of bytes (FIPS 180-4).
#pragma once

#include <memory>
#include <string>
#include <string_view>

#include <openssl/evp.h>

namespace tessel
{
class Sha256
{
public:
    Sha256();

    void add(std::string_view bytes);

    // 64 hexadecimal digits in small letters; nothing can be added after it.
    std::string finish();

private:
    struct Free
    {
        void operator()(EVP_MD_CTX* context) const { EVP_MD_CTX_free(context); }
    };

    std::unique_ptr<EVP_MD_CTX, Free> mContext;
};
} // namespace tessel
