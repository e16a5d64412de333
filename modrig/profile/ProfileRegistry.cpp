#include "modrig/profile/ProfileRegistry.h"

#include <tessel/tshostservices.h>

#include <cwchar>

namespace ModrigUtils
{
namespace
{
constexpr DWORD kDataBytes = 4096;
constexpr std::size_t kDataCharacters = kDataBytes / sizeof(wchar_t);
constexpr DWORD kNameCharacters = 1024;

enum class Access
{
    kRead, // the key must exist
    kWrite // the key is made if need be
};

// An open key, closed at the end of the scope.
class OpenKey
{
public:
    OpenKey(HKEY root, const CStdStr& subKey, Access access)
    {
        const LONG status = access == Access::kRead ? RegOpenKeyExW(root, subKey.c_str(), 0, KEY_READ, &mKey)
                                                    : RegCreateKeyEx(root, subKey.c_str(), 0, nullptr, 0,
                                                                     KEY_WRITE, nullptr, &mKey, nullptr);
        mbOpen = status == ERROR_SUCCESS;
    }
    ~OpenKey()
    {
        if (mbOpen)
            RegCloseKey(mKey);
    }
    OpenKey(const OpenKey&) = delete;
    OpenKey& operator=(const OpenKey&) = delete;

    explicit operator bool() const { return mbOpen; }
    HKEY get() const { return mKey; }

private:
    HKEY mKey = nullptr;
    bool mbOpen = false;
};

CStdStr ProfilesKey()
{
    TsDbHostApplicationServices* services = tsdbHostApplicationServices();
    return CStdStr(services ? services->productRegistryRoot() : L"") + CStdStr(L"\\Profiles");
}

// Writing without a value name makes the key and nothing else; whether that worked shows when values are
// stored.
void MakeKey(const CStdStr& key)
{
    static_cast<void>(WriteModrigRegString(HKEY_CURRENT_USER, key, CStdStr(), CStdStr()));
}
} // namespace

CStdStr GetModrigProfileRegKey()
{
    CStdStr key = ProfilesKey();
    CStdStr profile;
    if (!ReadModrigRegString(HKEY_CURRENT_USER, key, CStdStr(), profile))
        return CStdStr();
    key += CStdStr(L"\\") + profile + CStdStr(L"\\Dialogs");
    MakeKey(key);
    key += CStdStr(L"\\Modrig");
    MakeKey(key);
    return key;
}

bool ReadModrigRegString(HKEY root, const CStdStr& subKey, const CStdStr& valueName, CStdStr& data)
{
    const OpenKey key(root, subKey, Access::kRead);
    if (!key)
        return false;
    wchar_t buffer[kDataCharacters];
    DWORD type = REG_SZ;
    DWORD size = kDataBytes;
    if (tsRegGetValue(key.get(), valueName.c_str(), 0, &type, buffer, &size) != ERROR_SUCCESS)
        return false;
    data = CStdStr(std::wstring(buffer, wcsnlen(buffer, size / sizeof(wchar_t))));
    return true;
}

bool WriteModrigRegString(HKEY root, const CStdStr& subKey, const CStdStr& valueName, const CStdStr& data)
{
    const OpenKey key(root, subKey, Access::kWrite);
    if (!key)
        return false;
    // Without a name the key's existence is all that was asked for: the unnamed value is never set here. This
    // is how keys are made.
    if (valueName.IsEmpty())
        return true;
    return tsudRegSetString(key.get(), valueName.c_str(), data.c_str()) == ERROR_SUCCESS;
}

bool DeleteModrigRegString(HKEY root, const CStdStr& subKey, const CStdStr& valueName)
{
    const OpenKey key(root, subKey, Access::kWrite);
    if (!key)
        return false;
    if (valueName.IsEmpty())
        return true;
    return RegDeleteValueW(key.get(), valueName.c_str()) == ERROR_SUCCESS;
}

bool EnumModrigRegString(HKEY root, const CStdStr& subKey, CStringList& names)
{
    names.RemoveAll();
    const OpenKey key(root, subKey, Access::kRead);
    if (!key)
        return false;
    wchar_t name[kNameCharacters] = {};
    for (DWORD index = 0;; ++index)
    {
        DWORD length = kNameCharacters;
        const LONG status =
            RegEnumValueW(key.get(), index, name, &length, nullptr, nullptr, nullptr, nullptr);
        // Nothing else ends the walk: a name that does not fit is one value, not the last one.
        if (status == ERROR_NO_MORE_ITEMS)
            return true;
        names.AddTail(CStdStr(std::wstring(name)));
        name[0] = L'\0';
    }
}

bool SetRegModrigDirectory(signed char write, signed char mainDialog, CStdStr& directory)
{
    const CStdStr key = GetModrigProfileRegKey();
    const CStdStr name(mainDialog ? L"MainDialog" : L"AddAppDialog");
    if (!write)
        return ReadModrigRegString(HKEY_CURRENT_USER, key, name, directory);
    if (directory.IsEmpty())
        return false;
    // A folder that could not be remembered is no reason to trouble the user.
    static_cast<void>(WriteModrigRegString(HKEY_CURRENT_USER, key, name, directory));
    return true;
}
} // namespace ModrigUtils
