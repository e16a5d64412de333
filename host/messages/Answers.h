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

inline constexpr std::wstring_view kYes = L"Yes";
inline constexpr std::wstring_view kNo = L"No";

// Which of the two words the answer is, or begins.
std::optional<bool> yesOrNoIn(std::wstring_view answer, std::wstring_view yes = kYes,
                              std::wstring_view no = kNo);
std::wstring asText(bool yes);

// The path that was typed, without quotes around it; "~/" at its beginning is the home folder.
std::wstring pathIn(std::wstring_view answer);
} // namespace tessel
