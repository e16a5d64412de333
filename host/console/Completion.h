// What the Tab key makes of the beginning of a command's name.
#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace tessel
{
struct Completion
{
    std::wstring text;                    // what now stands in place of the typed beginning
    std::vector<std::wstring> candidates; // the names to choose from when there are several
};

// Names compare without regard to case. One name that fits is completed whole, with a blank after it; of
// several, as far as they agree. Nothing when no name fits, or when the line holds more than one word.
std::optional<Completion> completeCommand(std::wstring_view line, const std::vector<std::wstring>& names);
} // namespace tessel
