// Results for programs, as JSON (RFC 8259).
#pragma once

#include <nlohmann/json.hpp>

#include <string>
#include <string_view>
#include <vector>

namespace tessel
{
// Fields stand in the order in which they were given.
using Json = nlohmann::ordered_json;

namespace json
{
// Each answers a value. A library's text has to be UTF-8, which not every name of a file is: values are made
// here.
Json text(std::wstring_view content);
Json listOfTexts(const std::vector<std::wstring>& contents);

// On one line. What a terminal would take for an order stands as an escape, and so does a byte of a file's
// name that is no text: as the private character that it is in a wide text, U+10FE00 and the byte.
std::wstring written(const Json& document);
} // namespace json
} // namespace tessel
