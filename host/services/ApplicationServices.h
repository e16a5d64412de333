// What the host is, and the road to remote files.
#pragma once

#include <tessel/tshostservices.h>

namespace tessel
{
class ApplicationServices : public TsDbHostApplicationServices
{
public:
    const wchar_t* productRegistryRoot() const override;
    const wchar_t* product() const override;
    bool isUrl(const wchar_t* text) const override;
    int fetchRemoteFile(const wchar_t* url, wchar_t* localPath, std::size_t capacity,
                        bool ignoreCache) override;
};
} // namespace tessel
