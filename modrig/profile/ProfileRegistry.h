// The module's values in the host's registry, below the current profile.
//
// Every value is a string below HKEY_CURRENT_USER. No function here tells the user anything: each answers
// false and leaves the store as it was, and the caller reports.
#pragma once

#include <wincompat/winreg.h>

#include "modrig/base/CStringList.h"

namespace ModrigUtils
{
// The key of the module below HKEY_CURRENT_USER; makes sure that it exists. Empty, with nothing made, when
// the current profile cannot be read.
[[nodiscard]] CStdStr GetModrigProfileRegKey();

// Reads a value of up to 1023 characters; a longer one cannot be read. `data` is untouched on failure.
[[nodiscard]] bool ReadModrigRegString(HKEY root, const CStdStr& subKey, const CStdStr& valueName,
                                       CStdStr& data);

// Stores a value; the key and its parents are made. An empty name only makes sure that the key exists.
[[nodiscard]] bool WriteModrigRegString(HKEY root, const CStdStr& subKey, const CStdStr& valueName,
                                        const CStdStr& data);

// Removes a value; the key is made if need be. False when there is no such value. An empty name removes
// nothing and answers true.
[[nodiscard]] bool DeleteModrigRegString(HKEY root, const CStdStr& subKey, const CStdStr& valueName);

// Fills the list with the names of the key's values in the store's order. The list is empty on failure.
[[nodiscard]] bool EnumModrigRegString(HKEY root, const CStdStr& subKey, CStringList& names);

// Reads (`write` 0) or stores the folder remembered for the main dialog or, with `mainDialog` 0, for the
// dialog that adds applications. Reading: false, with `directory` untouched, when none is stored. Storing:
// false for an empty folder, else true.
[[nodiscard]] bool SetRegModrigDirectory(signed char write, signed char mainDialog, CStdStr& directory);
} // namespace ModrigUtils
