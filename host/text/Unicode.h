// Conversions between the encodings that meet in the host. None of them fails: what is not text becomes
// U+FFFD.
#pragma once

#include <string>
#include <string_view>

namespace tessel
{
std::wstring toWide(std::string_view utf8);
std::string toUtf8(std::wstring_view text);

// The text with every character folded for comparison without regard to case (simple case folding of
// Unicode, independent of the locale).
std::wstring foldCase(std::wstring_view text);

bool equalIgnoringCase(std::wstring_view left, std::wstring_view right);
} // namespace tessel
