// Conversions between the encodings that meet in the host. None of them fails.
//
// The name of a file need not be text. In a wide text a byte NN of it that is no UTF-8 stands as the private
// character U+10FENN, and becomes that byte again on the way back: every file is found by its wide name. The
// private character itself, should a name contain it, stands as its four bytes. Halves of surrogate pairs
// would do as well, were they not refused by the platform's strings.
#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>

namespace tessel
{
std::wstring toWide(std::string_view utf8);
std::wstring toWide(std::u16string_view utf16);
// What is no character at all becomes U+FFFD.
std::string toUtf8(std::wstring_view text);
std::u16string toUtf16(std::wstring_view text);

// The character that begins at the position, which moves past it; nothing, and past one byte, where the bytes
// are no text. Safe in a signal handler.
std::optional<char32_t> takeUtf8(std::string_view utf8, std::size_t& position) noexcept;

// The text for a person's eyes: bytes that are no text are written as escapes, \xFF.
std::wstring withReadableBytes(std::wstring_view text);

// The text with every character folded for comparison without regard to case (simple case folding of
// Unicode, independent of the locale).
std::wstring foldCase(std::wstring_view text);

// The same in UTF-8.
std::string foldedUtf8(std::wstring_view text);

bool equalIgnoringCase(std::wstring_view left, std::wstring_view right);
} // namespace tessel
