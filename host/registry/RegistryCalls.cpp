// The Windows-style registry calls, on the running host's registry.
#include <wincompat/winreg.h>

#include <cstring>

#include "host/registry/LayeredRegistry.h"
#include "host/text/CallersBuffer.h"
#include "host/text/Running.h"
#include "host/text/Unicode.h"

using tessel::LayeredRegistry;
using tessel::Registry;

namespace
{
// The registry and the key that a handle stands for, if both are there.
struct Target
{
    LayeredRegistry* registry = nullptr;
    Registry::Key key = Registry::kNoKey;

    explicit operator bool() const { return registry != nullptr; }
};

Target targetOf(HKEY handle)
{
    LayeredRegistry* registry = tessel::running<LayeredRegistry>();
    const auto key = registry ? registry->keyOf(handle) : std::nullopt;
    return key ? Target{registry, *key} : Target{};
}

const wchar_t* orEmpty(const wchar_t* text)
{
    return text ? text : L"";
}

// What is not found may only not have been readable.
LONG notFound(const LayeredRegistry& registry)
{
    return registry.own().mayHaveMissed() ? ERROR_READ_FAULT : ERROR_FILE_NOT_FOUND;
}

LONG copyData(const std::wstring& data, void* buffer, DWORD* size)
{
    const DWORD capacity = *size;
    *size = static_cast<DWORD>((data.size() + 1) * sizeof(wchar_t));
    if (!buffer)
        return ERROR_SUCCESS;
    if (*size > capacity)
        return ERROR_MORE_DATA;
    std::memcpy(buffer, data.c_str(), *size);
    return ERROR_SUCCESS;
}
} // namespace

LONG RegOpenKeyExW(HKEY root, const wchar_t* subKey, DWORD, DWORD, HKEY* result)
{
    if (!result)
        return ERROR_INVALID_PARAMETER;
    const Target target = targetOf(root);
    if (!target)
        return ERROR_INVALID_HANDLE;
    const Registry::Key key = target.registry->find(orEmpty(subKey), target.key);
    if (key == Registry::kNoKey)
        return notFound(*target.registry);
    *result = target.registry->openHandle(key);
    return ERROR_SUCCESS;
}

LONG RegCreateKeyEx(HKEY root, const wchar_t* subKey, DWORD, const wchar_t*, DWORD, DWORD, const void*,
                    HKEY* result, DWORD* disposition)
{
    if (!result)
        return ERROR_INVALID_PARAMETER;
    const Target target = targetOf(root);
    if (!target)
        return ERROR_INVALID_HANDLE;
    const bool existed =
        disposition && target.registry->find(orEmpty(subKey), target.key) != Registry::kNoKey;
    const auto key = target.registry->create(orEmpty(subKey), target.key);
    if (!key)
        return key.code();
    if (disposition)
        *disposition = existed ? REG_OPENED_EXISTING_KEY : REG_CREATED_NEW_KEY;
    *result = target.registry->openHandle(*key);
    return ERROR_SUCCESS;
}

LONG RegEnumValueW(HKEY key, DWORD index, wchar_t* name, DWORD* nameLength, DWORD*, DWORD* type, BYTE* data,
                   DWORD* dataSize)
{
    if (!name || !nameLength || (data && !dataSize))
        return ERROR_INVALID_PARAMETER;
    const Target target = targetOf(key);
    if (!target)
        return ERROR_INVALID_HANDLE;
    const auto found = target.registry->valueName(target.key, index);
    if (!found)
        return found.code();
    if (!tessel::copyWhole(*found, name, *nameLength))
        return ERROR_MORE_DATA;
    *nameLength = static_cast<DWORD>(found->size());
    return type || dataSize ? tsRegGetValue(key, found->c_str(), 0, type, data, dataSize) : ERROR_SUCCESS;
}

LONG RegDeleteValueW(HKEY key, const wchar_t* name)
{
    const Target target = targetOf(key);
    if (!target)
        return ERROR_INVALID_HANDLE;
    target.registry->expectReplacement(target.key);
    return target.registry->removeValue(target.key, orEmpty(name)).code();
}

LONG RegCloseKey(HKEY key)
{
    const Target target = targetOf(key);
    return target && target.registry->closeHandle(key) ? ERROR_SUCCESS : ERROR_INVALID_HANDLE;
}

LONG RegFlushKey(HKEY key)
{
    const Target target = targetOf(key);
    return target ? target.registry->store().code() : ERROR_INVALID_HANDLE;
}

LONG tsRegGetValue(HKEY key, const wchar_t* name, DWORD, DWORD* type, void* data, DWORD* size)
{
    if (data && !size)
        return ERROR_INVALID_PARAMETER;
    const Target target = targetOf(key);
    if (!target)
        return ERROR_INVALID_HANDLE;
    const auto found = target.registry->readValue(target.key, orEmpty(name));
    if (!found)
        return found.code() == ERROR_FILE_NOT_FOUND ? notFound(*target.registry) : found.code();
    if (type)
        *type = REG_SZ;
    return size ? copyData(*found, data, size) : ERROR_SUCCESS;
}

LONG tsudRegSetString(HKEY key, const wchar_t* name, const wchar_t* data)
{
    const Target target = targetOf(key);
    if (!target)
        return ERROR_INVALID_HANDLE;
    target.registry->expectReplacement(target.key);
    return target.registry->writeValue(target.key, orEmpty(name), orEmpty(data)).code();
}

bool tsRegIsLaidDown(HKEY key, const wchar_t* name, wchar_t* place, std::size_t capacity)
{
    const Target target = targetOf(key);
    const auto file = target ? target.registry->laidDownIn(target.key, orEmpty(name)) : std::nullopt;
    if (file)
        tessel::copyCut(tessel::toWide(file->native()), place, capacity);
    return file.has_value();
}

bool tsRegMayHaveMissed(const wchar_t* path, const wchar_t* name, wchar_t* reason, std::size_t capacity)
{
    LayeredRegistry* registry = tessel::running<LayeredRegistry>();
    if (!registry || !registry->mayHaveMissed(orEmpty(path), orEmpty(name)))
        return false;
    tessel::copyCut(registry->own().takeReason(), reason, capacity);
    return true;
}
