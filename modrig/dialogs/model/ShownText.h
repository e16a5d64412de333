// Names of files as they are shown.
#pragma once

#include "modrig/base/CStdStr.h"

namespace ModrigUtils
{
// The text in one line: what is no visible character, a line break in a file's name, say, is written as the
// escape that programmers know: \n, \t, \x1B; so is what is no text at all, \xFF.
[[nodiscard]] CStdStr ShownText(const CStdStr& text);
} // namespace ModrigUtils
