// The SHA-256 of bytes, by the library that has it.
#pragma once

#include <memory>
#include <string>
#include <string_view>

#include <openssl/evp.h>

#include "host/files/network/Network.h"

namespace tessel
{
class Sha256 : public Checksum
{
public:
    Sha256();

    void add(std::string_view bytes) override;
    std::string finish() override;

private:
    struct Free
    {
        void operator()(EVP_MD_CTX* context) const { EVP_MD_CTX_free(context); }
    };

    std::unique_ptr<EVP_MD_CTX, Free> mContext;
};
} // namespace tessel
