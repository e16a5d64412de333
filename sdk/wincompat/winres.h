// Resource modules: portable executables whose string tables hold an application's texts.
#pragma once

#include "wintypes.h"

// Opens a resource module: a full path, or a name looked for in the resources of the application that is
// being called and then in the host's. Both separators are allowed. Null when it is missing or is not a
// sound file; the host has then said why on the command line.
TESSEL_API HMODULE LoadLibrary(const wchar_t* name);

// Closes it. Non-zero on success, 0 for a handle that is not open.
TESSEL_API int FreeLibrary(HMODULE module);

// The module in which texts are looked up when none is named; null before the first set.
TESSEL_API HMODULE AfxGetResourceHandle();
TESSEL_API void AfxSetResourceHandle(HMODULE module);

// Copies string `id` of the module (null: the current one), in the first of the person's languages in which
// the module has it and else in the first of the module's, into the buffer, cut to capacity - 1 characters
// and terminated. Answers the characters copied, 0 when there is no such string (the buffer is then an empty
// text). Text outside the basic plane becomes one wide character.
TESSEL_API int loadStringFromWin32ResourceDLL(HMODULE module, unsigned id, wchar_t* buffer, int capacity);
