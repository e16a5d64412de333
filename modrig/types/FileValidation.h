// What the dialogs ask about a chosen or dropped file before they accept it.
#pragma once

#include "modrig/base/CStdStr.h"

namespace ModrigUtils
{
// Whether the file has the extension of an application kind. A path without a dot, or ending with one:
// kCannotLoadFile and false; an unknown extension is refused silently.
[[nodiscard]] bool IsValidFileForModrig(const CStdStr& path);

// The attributes of the file, or INVALID_FILE_ATTRIBUTES when it is not found. A file that is missing where
// the path says is looked for by its name, first in the current folder, then along the host's search path; a
// name without an extension is tried with that of every application kind in table order. `path` becomes the
// path of the file found. A path that is too long to be taken apart is found where it says or not at all.
[[nodiscard]] DWORD ValidateFileExists(CStdStr& path);

// Whether the file is a local copy of one from the internet, which may be gone at the next start.
[[nodiscard]] bool IsTempInternetFile(const CStdStr& path);

// Turns a URL into the path of a local copy. Any other path stays as it was given. When the fetch fails:
// kUrlNotFetched, and the path is left without its closing separators. The second argument is not used.
void ValidateURLFile(CStdStr& path, void* reserved);
} // namespace ModrigUtils
