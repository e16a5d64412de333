#include "host/applications/SdkVersion.h"

#include <string>

#include <tessel/tsversion.h>

#include "host/text/Translation.h"

namespace tessel
{
namespace
{
constexpr SdkVersion kOwnSdk = {TESSEL_SDK_VERSION_MAJOR, TESSEL_SDK_VERSION_MINOR};

std::wstring asText(const SdkVersion& version)
{
    return std::to_wstring(version.majorNumber) + L"." + std::to_wstring(version.minorNumber);
}
} // namespace

Result<> checkSdkVersion(const std::optional<SdkVersion>& wanted)
{
    if (!wanted || *wanted <= kOwnSdk)
        return {};
    return Failure{
        translated(L"it is built for version {} of the SDK, and this Tessel has {}; it needs a newer "
                   L"Tessel, or to be built with the SDK of this one",
                   asText(*wanted), asText(kOwnSdk))};
}
} // namespace tessel
