// Results for programs, as JSON (RFC 8259).
#pragma once

#include <string>
#include <string_view>

namespace ModrigUtils
{
// The text as a JSON string, in its quotes. What a terminal would take for an order stands as an escape, and
// so does a byte of a file's name that is no text: as the private character that it is here, U+10FE00 and the
// byte.
[[nodiscard]] std::wstring InJson(std::wstring_view text);
} // namespace ModrigUtils
