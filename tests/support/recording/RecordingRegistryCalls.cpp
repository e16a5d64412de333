// The registry functions of the SDK, on the recording host's registry.
#include <wincompat/winreg.h>

#include "tests/support/RecordingHost.h"

LONG RegOpenKeyExW(HKEY root, const wchar_t* subKey, DWORD, DWORD access, HKEY* result)
{
    return recordingHost().registry.open(root, subKey, access, result);
}

LONG RegCreateKeyEx(HKEY root, const wchar_t* subKey, DWORD, const wchar_t*, DWORD, DWORD access, const void*,
                    HKEY* result, DWORD* disposition)
{
    return recordingHost().registry.create(root, subKey, access, result, disposition);
}

LONG RegEnumValueW(HKEY key, DWORD index, wchar_t* name, DWORD* nameLength, DWORD*, DWORD* type, BYTE* data,
                   DWORD* dataSize)
{
    return recordingHost().registry.enumerate(key, index, name, nameLength, type, data, dataSize);
}

LONG RegDeleteValueW(HKEY key, const wchar_t* name)
{
    return recordingHost().registry.remove(key, name);
}

LONG RegCloseKey(HKEY key)
{
    return recordingHost().registry.close(key);
}

LONG tsRegGetValue(HKEY key, const wchar_t* name, DWORD, DWORD* type, void* data, DWORD* size)
{
    return recordingHost().registry.read(key, name, type, data, size);
}

LONG tsudRegSetString(HKEY key, const wchar_t* name, const wchar_t* data)
{
    return recordingHost().registry.write(key, name, data);
}
