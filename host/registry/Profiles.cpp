#include "host/registry/Profiles.h"

#include <tessel/tshostservices.h>

#include "host/Services.h"
#include "host/registry/Registry.h"

namespace tessel
{
namespace
{
constexpr wchar_t kCurrentProfileValue[] = L""; // the unnamed value of the key that holds the profiles
constexpr std::size_t kLongestName = 255;

std::wstring profilesKey()
{
    return std::wstring(tsdbHostApplicationServices()->productRegistryRoot()) + L"\\Profiles";
}

bool isProfileName(const std::wstring& name)
{
    return !name.empty() && name.size() <= kLongestName && name.find(L'\\') == name.npos;
}
} // namespace

std::wstring currentProfile()
{
    return services().registry->read(profilesKey(), kCurrentProfileValue).value_or(L"");
}

Result<> setCurrentProfile(const std::wstring& name)
{
    if (!isProfileName(name))
        return Failure{L"\"" + name + L"\" cannot be the name of a profile."};
    if (!services().registry->write(profilesKey(), kCurrentProfileValue, name))
        return Failure{L"The profile cannot be changed to \"" + name +
                       L"\": the registry cannot be written."};
    return {};
}
} // namespace tessel
