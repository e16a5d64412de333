// Where the moon stands between one new moon and the next, and how that looks.
#pragma once

#include <ctime>
#include <string>

namespace moon
{
inline constexpr double kDaysOfMonth = 29.530588853; // from new moon to new moon, on average
inline constexpr unsigned kPhases = 8;

// The part of the month that has passed: 0 at the new moon, 0.5 at the full moon, always below 1. Right to
// about half a day, since the real month varies.
double phaseAt(std::time_t time);

// Which of the eight phases, from 0 for the new moon.
unsigned phaseIndex(double phase);

// How much of the disc is lit, from 0 to 1.
double litPart(double phase);

// The disc as lines of text, as the northern hemisphere sees it.
std::wstring picture(double phase);
} // namespace moon
