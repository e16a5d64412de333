// The registry: hierarchical keys with values. Key and value names compare without regard to case (simple
// case folding of Unicode) and keep the spelling they were created with. The parts of a key path are
// separated by one backslash; empty parts are passed over. Changes made while a command runs are stored
// together when it ends, or not at all.
#pragma once

#include "wintypes.h"

inline const HKEY HKEY_CURRENT_USER = reinterpret_cast<HKEY>(std::uintptr_t{0x80000001});

inline constexpr DWORD KEY_READ = 0x20019;
inline constexpr DWORD KEY_WRITE = 0x20006;
inline constexpr DWORD REG_SZ = 1;

// What `RegCreateKeyEx` found.
inline constexpr DWORD REG_CREATED_NEW_KEY = 1;
inline constexpr DWORD REG_OPENED_EXISTING_KEY = 2;

// Opens an existing key. ERROR_FILE_NOT_FOUND when there is none, ERROR_READ_FAULT when there may be one: the
// store cannot be read, or is damaged. `*result` is closed with `RegCloseKey`.
TESSEL_API LONG RegOpenKeyExW(HKEY root, const wchar_t* subKey, DWORD reserved, DWORD access, HKEY* result);

// Opens a key and makes it and its missing parents. `keyClass`, `security` and `disposition` may be null.
// ERROR_ACCESS_DENIED, ERROR_DISK_FULL or ERROR_WRITE_FAULT when the store cannot be written.
TESSEL_API LONG RegCreateKeyEx(HKEY root, const wchar_t* subKey, DWORD reserved, const wchar_t* keyClass,
                               DWORD options, DWORD access, const void* security, HKEY* result,
                               DWORD* disposition);

// The name of the value at an index from 0, in the order in which the values were created. `*nameLength` is
// the buffer's size in characters, the terminator included, and becomes the name's length without it. The
// data may be asked for as with `tsRegGetValue`, or not (null). ERROR_NO_MORE_ITEMS past the last value,
// ERROR_MORE_DATA when the name does not fit.
TESSEL_API LONG RegEnumValueW(HKEY key, DWORD index, wchar_t* name, DWORD* nameLength, DWORD* reserved,
                              DWORD* type, BYTE* data, DWORD* dataSize);

// Removes a value. ERROR_FILE_NOT_FOUND when there is none.
TESSEL_API LONG RegDeleteValueW(HKEY key, const wchar_t* name);

TESSEL_API LONG RegCloseKey(HKEY key);

// Stores what the command has written so far, in all keys, and answers whether it is stored now: for who is
// about to say that it is. Writes that succeed may wait for the command's end, and fail there.
TESSEL_API LONG RegFlushKey(HKEY key);

// The host's own value calls. Reading: `*type` is set to the value's type and `*size` (bytes, in: the
// buffer's, out: the data's with its terminator); ERROR_FILE_NOT_FOUND, ERROR_READ_FAULT when the value may
// be there all the same, or ERROR_MORE_DATA when it does not fit (the buffer is then untouched). An empty
// name is the key's unnamed value.
TESSEL_API LONG tsRegGetValue(HKEY key, const wchar_t* name, DWORD reserved, DWORD* type, void* data,
                              DWORD* size);

// Stores a string value (REG_SZ). A value that exists keeps its place in the order.
TESSEL_API LONG tsudRegSetString(HKEY key, const wchar_t* name, const wchar_t* data);

// Whether an administrator has laid the value down for everybody: then it counts, and not what is stored
// under its name here. `place`, when not null, receives where it is laid down, as far as it fits (capacity in
// characters, the terminator included). False for a handle that is not open.
TESSEL_API bool tsRegIsLaidDown(HKEY key, const wchar_t* name, wchar_t* place, std::size_t capacity);

// Whether something else may count under the name than what is read there: the person's registry cannot be
// read, or is damaged. `path` is that of the key below HKEY_CURRENT_USER. `reason`, when not null, receives
// whole sentences for the person, about the file, what is the matter and what helps, as far as they fit
// (capacity in characters, the terminator included); then the host does not tell them at the end of the
// command, which is to fail.
TESSEL_API bool tsRegMayHaveMissed(const wchar_t* path, const wchar_t* name, wchar_t* reason,
                                   std::size_t capacity);
