#include "MoonPhase.h"

#include <cmath>
#include <numbers>

namespace moon
{
namespace
{
constexpr double kSecondsPerDay = 86400;
constexpr double kKnownNewMoon = 947182440; // 6 January 2000, 18:14 UTC, in seconds since 1970
constexpr int kRadius = 8;                  // in lines
constexpr double kCharacterAspect = 2;      // a character is about twice as high as wide

constexpr wchar_t kSky = L' ';
constexpr wchar_t kLit = L'@';
constexpr wchar_t kDark = L'.';

// The border between light and dark is half an ellipse from pole to pole. It moves over the disc from right
// to left in the first half of the month, and once more in the second.
bool isLit(double x, double y, double phase)
{
    const double border = std::cos(2 * std::numbers::pi * phase) * std::sqrt(1 - y * y);
    return phase < 0.5 ? x > border : x < -border;
}

wchar_t characterAt(double x, double y, double phase)
{
    if (x * x + y * y > 1)
        return kSky;
    return isLit(x, y, phase) ? kLit : kDark;
}
} // namespace

double phaseAt(std::time_t time)
{
    const double days = (static_cast<double>(time) - kKnownNewMoon) / kSecondsPerDay;
    const double months = days / kDaysOfMonth;
    return months - std::floor(months);
}

unsigned phaseIndex(double phase)
{
    return static_cast<unsigned>(std::lround(phase * kPhases)) % kPhases;
}

double litPart(double phase)
{
    return (1 - std::cos(2 * std::numbers::pi * phase)) / 2;
}

std::wstring picture(double phase)
{
    constexpr int kHalfWidth = static_cast<int>(kRadius * kCharacterAspect);
    std::wstring lines;
    for (int row = -kRadius; row <= kRadius; ++row)
    {
        for (int column = -kHalfWidth; column <= kHalfWidth; ++column)
            lines += characterAt(column / (kHalfWidth + 0.5), row / (kRadius + 0.5), phase);
        lines.erase(lines.find_last_not_of(kSky) + 1);
        lines += L'\n';
    }
    return lines;
}
} // namespace moon
