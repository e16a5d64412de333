// A point in time as people read it.
#pragma once

#include <array>
#include <ctime>
#include <string>

#include "host/text/Translation.h"
#include "host/text/Unicode.h"

namespace tessel
{
// "2026-11-22 09:41", by the clock of the place.
inline std::string dayAndTime(std::time_t seconds, const std::string& form = "%Y-%m-%d %H:%M")
{
    std::tm local = {};
    std::array<char, 64> text = {};
    localtime_r(&seconds, &local);
    return {text.data(), std::strftime(text.data(), text.size(), form.c_str(), &local)};
}

// As the person's language has it.
inline std::wstring dayAndTimeInWords(std::time_t seconds)
{
    return toWide(dayAndTime(seconds, translatedInUtf8(L"%Y-%m-%d %H:%M")));
}
} // namespace tessel
