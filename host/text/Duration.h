// How long something took, as a person is told it.
#pragma once

#include <chrono>
#include <iomanip>
#include <sstream>
#include <string>

#include "host/text/Translation.h"

namespace tessel
{
// "0.4 ms", "37 ms", "2.1 s".
inline std::wstring durationInWords(std::chrono::microseconds time)
{
    using Milliseconds = std::chrono::duration<double, std::milli>;
    constexpr Milliseconds kWithoutTenths{10};
    constexpr Milliseconds kSecond{1000};
    const Milliseconds milliseconds = time;
    std::wostringstream text;
    text << std::fixed << std::setprecision(milliseconds < kWithoutTenths || milliseconds >= kSecond ? 1 : 0);
    if (milliseconds < kSecond)
        text << milliseconds.count() << L" ms";
    else
        text << milliseconds / kSecond << L" s";
    std::wstring words = text.str();
    if (const auto mark = words.find(L'.'); mark != words.npos)
        words.replace(mark, 1, translated(L".")); // between whole numbers and tenths
    return words;
}
} // namespace tessel
