// What a person's answer means; nothing where it does not fit what was asked for.
#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace tessel
{
// Without blanks around it.
std::wstring trimmed(std::wstring_view text);

std::optional<double> numberIn(std::wstring_view answer);
std::wstring asText(double number);

std::optional<bool> yesOrNoIn(std::wstring_view answer);
std::wstring asText(bool yes);

// The path that was typed, without quotes around it; "~/" at its beginning is the home folder.
std::wstring pathIn(std::wstring_view answer);
} // namespace tessel
