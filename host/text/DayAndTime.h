// A point in time as people read it.
#pragma once

#include <array>
#include <ctime>
#include <string>

namespace tessel
{
// "2026-11-22 09:41", by the clock of the place.
inline std::string dayAndTime(std::time_t seconds)
{
    std::tm local = {};
    std::array<char, 32> text = {};
    localtime_r(&seconds, &local);
    return {text.data(), std::strftime(text.data(), text.size(), "%Y-%m-%d %H:%M", &local)};
}
} // namespace tessel
