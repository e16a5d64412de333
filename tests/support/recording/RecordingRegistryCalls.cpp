// The registry functions of the SDK, on the recording host's registry.
#include <wincompat/winreg.h>

#include "tests/support/RecordingHost.h"

LONG RegOpenKeyExW(HKEY root, const wchar_t* subKey, DWORD reserved, DWORD access, HKEY* result)
{
    return recordingHost().registry.open({.access = access, .reserved = reserved}, root, subKey, result);
}

LONG RegCreateKeyEx(HKEY root, const wchar_t* subKey, DWORD reserved, const wchar_t* keyClass, DWORD options,
                    DWORD access, const void* security, HKEY* result, DWORD* disposition)
{
    RecordingRegistry::Call call = {.access = access, .reserved = reserved, .options = options};
    if (keyClass)
        call.keyClass = keyClass;
    call.hasSecurity = security != nullptr;
    call.asksForDisposition = disposition != nullptr;
    return recordingHost().registry.create(call, root, subKey, result, disposition);
}

LONG RegEnumValueW(HKEY key, DWORD index, wchar_t* name, DWORD* nameLength, DWORD* reserved, DWORD* type,
                   BYTE* data, DWORD* dataSize)
{
    RecordingRegistry::Call call = {.index = index, .size = *nameLength};
    call.asksForData = reserved || type || data || dataSize;
    return recordingHost().registry.enumerate(call, key, name, nameLength, type, data, dataSize);
}

LONG RegDeleteValueW(HKEY key, const wchar_t* name)
{
    return recordingHost().registry.remove(key, name);
}

LONG RegCloseKey(HKEY key)
{
    return recordingHost().registry.close(key);
}

LONG RegFlushKey(HKEY key)
{
    return recordingHost().registry.flush(key);
}

LONG tsRegGetValue(HKEY key, const wchar_t* name, DWORD reserved, DWORD* type, void* data, DWORD* size)
{
    RecordingRegistry::Call call = {.reserved = reserved};
    call.type = type ? *type : 0;
    call.size = size ? *size : 0;
    return recordingHost().registry.read(call, key, name, type, data, size);
}

LONG tsudRegSetString(HKEY key, const wchar_t* name, const wchar_t* data)
{
    return recordingHost().registry.write(key, name, data);
}

// Nobody lays values down here.
bool tsRegIsLaidDown(HKEY, const wchar_t*, wchar_t*, std::size_t)
{
    return false;
}

bool tsRegMayHaveMissed(const wchar_t*, const wchar_t*, wchar_t* reason, std::size_t capacity)
{
    const auto& missed = recordingHost().registry.whyUnreadable;
    if (missed && reason && capacity > 0)
        reason[missed->copy(reason, capacity - 1)] = L'\0';
    return missed.has_value();
}
