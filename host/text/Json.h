// Results for programs, as JSON (RFC 8259). Each function answers a piece of text that is a value.
#pragma once

#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace tessel::json
{
// What a terminal would take for an order stands as an escape, and so does a byte of a file's name that is no
// text: as the private character that it is in a wide text, U+10FE00 and the byte.
std::wstring text(std::wstring_view content);

std::wstring truth(bool value);

std::wstring list(const std::vector<std::wstring>& values);
std::wstring listOfTexts(const std::vector<std::wstring>& contents);

// In the order given.
using Fields = std::vector<std::pair<std::wstring_view, std::wstring>>;
std::wstring object(const Fields& fields);
} // namespace tessel::json
