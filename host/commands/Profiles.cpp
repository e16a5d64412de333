#include "host/commands/Profiles.h"

#include <array>

#include <tessel/tshostservices.h>
#include <wincompat/winreg.h>

#include "host/commands/BuiltInSupport.h"

namespace tessel
{
namespace
{
constexpr wchar_t kFirstProfile[] = L"Standard";
constexpr wchar_t kCurrentProfileValue[] = L""; // the unnamed value of the key that holds the profiles
constexpr std::size_t kLongestName = 256;

std::wstring profilesKey()
{
    return std::wstring(tsdbHostApplicationServices()->productRegistryRoot()) + L"\\Profiles";
}

bool isProfileName(const std::wstring& name)
{
    return !name.empty() && name.size() < kLongestName && name.find(L'\\') == name.npos;
}

bool writeCurrentProfile(const std::wstring& name)
{
    HKEY key = nullptr;
    if (RegCreateKeyEx(HKEY_CURRENT_USER, profilesKey().c_str(), 0, nullptr, 0, KEY_WRITE, nullptr, &key,
                       nullptr) != ERROR_SUCCESS)
        return false;
    const bool written = tsudRegSetString(key, kCurrentProfileValue, name.c_str()) == ERROR_SUCCESS;
    RegCloseKey(key);
    return written;
}
} // namespace

std::wstring currentProfile()
{
    HKEY key = nullptr;
    if (RegOpenKeyExW(HKEY_CURRENT_USER, profilesKey().c_str(), 0, KEY_READ, &key) != ERROR_SUCCESS)
        return {};
    std::array<wchar_t, kLongestName> name{};
    DWORD type = REG_SZ;
    DWORD size = sizeof name;
    const LONG status = tsRegGetValue(key, kCurrentProfileValue, 0, &type, name.data(), &size);
    RegCloseKey(key);
    return status == ERROR_SUCCESS ? name.data() : L"";
}

bool setCurrentProfile(const std::wstring& name)
{
    if (!isProfileName(name))
        return fail(L"\"" + name + L"\" cannot be the name of a profile.");
    if (!writeCurrentProfile(name))
        return fail(L"The profile cannot be changed to \"" + name + L"\": the registry cannot be written.");
    return true;
}

void ensureProfile()
{
    // A registry that cannot be written has been told about when it was opened.
    if (currentProfile().empty())
        writeCurrentProfile(kFirstProfile);
}
} // namespace tessel
