// Which letter of a control's text stands for it, with Alt.
#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

namespace tessel::windowing
{
using MnemonicPlaces = std::vector<std::optional<std::size_t>>;

// For each of the texts the place of its letter, all of them different without regard to case, and from the
// letters that are taken; none where all letters of a text are needed elsewhere. First letters come first,
// then those of further words.
MnemonicPlaces chooseMnemonics(const std::vector<std::wstring>& texts, const std::wstring& taken = {});

bool isMnemonic(wchar_t letter, wchar_t typed);
} // namespace tessel::windowing
