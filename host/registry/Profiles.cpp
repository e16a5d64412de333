#include "host/registry/Profiles.h"

#include <tessel/tshostservices.h>

#include "host/Services.h"
#include "host/registry/Registry.h"
#include "host/text/CommandLine.h"

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
bool refuse(const std::wstring& sentence)
{
    services().commandLine->say(sentence);
    return false;
}
} // namespace

std::wstring currentProfile()
{
    return services().registry->read(profilesKey(), kCurrentProfileValue).value_or(L"");
}

bool setCurrentProfile(const std::wstring& name)
{
    if (!isProfileName(name))
        return refuse(L"\"" + name + L"\" cannot be the name of a profile.");
    if (!services().registry->write(profilesKey(), kCurrentProfileValue, name))
        return refuse(L"The profile cannot be changed to \"" + name + L"\": the registry cannot be written.");
    return true;
}
} // namespace tessel
