#import <tesselui/TsUIPersistentStore.h>

#include <tessel/tshostservices.h>
#include <wincompat/winreg.h>
#include <wincompat/winstring.h>

#include <optional>
#include <string>
#include <utility>
#include <vector>

namespace
{
// An open key of the registry; whether it is open, the caller asks.
class OpenKey
{
public:
    explicit OpenKey(const std::wstring& path)
    {
        mOpen = RegOpenKeyExW(HKEY_CURRENT_USER, path.c_str(), 0, KEY_READ, &mKey) == ERROR_SUCCESS;
    }
    static OpenKey making(const std::wstring& path)
    {
        OpenKey key;
        key.mOpen = RegCreateKeyEx(HKEY_CURRENT_USER, path.c_str(), 0, nullptr, 0, KEY_WRITE, nullptr,
                                   &key.mKey, nullptr) == ERROR_SUCCESS;
        return key;
    }
    ~OpenKey()
    {
        if (mOpen)
            RegCloseKey(mKey);
    }
    OpenKey(const OpenKey&) = delete;
    OpenKey& operator=(const OpenKey&) = delete;
    OpenKey(OpenKey&& other) noexcept : mKey(other.mKey), mOpen(std::exchange(other.mOpen, false)) {}

    explicit operator bool() const { return mOpen; }
    HKEY get() const { return mKey; }

private:
    OpenKey() = default;

    HKEY mKey = nullptr;
    bool mOpen = false;
};

std::optional<std::wstring> readValue(const std::wstring& path, const std::wstring& name)
{
    const OpenKey key(path);
    DWORD type = 0;
    DWORD size = 0;
    if (!key || tsRegGetValue(key.get(), name.c_str(), 0, &type, nullptr, &size) == ERROR_FILE_NOT_FOUND)
        return std::nullopt;
    std::vector<wchar_t> text(size / sizeof(wchar_t) + 1);
    if (tsRegGetValue(key.get(), name.c_str(), 0, &type, text.data(), &size) != ERROR_SUCCESS)
        return std::nullopt;
    return std::wstring(text.data());
}

std::wstring settingsKey(NSString* group)
{
    const TsDbHostApplicationServices* services = tsdbHostApplicationServices();
    const std::wstring profiles =
        std::wstring(services ? services->productRegistryRoot() : L"") + L"\\Profiles";
    const std::wstring profile = readValue(profiles, L"").value_or(L"");
    return profiles + L"\\" + profile + L"\\DialogSettings\\" + NSStringToWstring(group);
}

// A dialog that could not remember something is no reason to trouble its user.
void writeValue(NSString* group, NSString* control, NSString* value)
{
    const OpenKey key = OpenKey::making(settingsKey(group));
    if (!key)
        return;
    const std::wstring name = NSStringToWstring(control);
    if (value)
        tsudRegSetString(key.get(), name.c_str(), NSStringToWstring(value).c_str());
    else
        RegDeleteValueW(key.get(), name.c_str());
}
} // namespace

@implementation TsUIPersistentStore

- (void)putControlState:(NSString*)group control:(NSString*)control state:(NSInteger)state
{
    [self putControlInt:group control:control value:state ? 1 : 0];
}

- (NSInteger)getControlState:(NSString*)group control:(NSString*)control
{
    return [self getControlInt:group control:control] ? 1 : 0;
}

- (void)putControlInt:(NSString*)group control:(NSString*)control value:(int)value
{
    writeValue(group, control, [NSString stringWithFormat:@"%d", value]);
}

- (int)getControlInt:(NSString*)group control:(NSString*)control
{
    return [[self getControlString:group control:control] intValue];
}

- (void)putControlString:(NSString*)group control:(NSString*)control value:(NSString*)value
{
    writeValue(group, control, value);
}

- (NSString*)getControlString:(NSString*)group control:(NSString*)control
{
    const auto value = readValue(settingsKey(group), NSStringToWstring(control));
    return value ? wcharToNSString(value->c_str()) : nil;
}

@end
