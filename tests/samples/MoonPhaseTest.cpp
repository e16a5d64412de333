#include "samples/moon/MoonPhase.h"

#include <gmock/gmock.h>

#include <algorithm>
#include <cmath>

namespace
{
// The real month is up to half a day longer or shorter than the average one.
constexpr double kHalfADay = 0.5 / moon::kDaysOfMonth + 0.005;

constexpr std::time_t kFullMoon = 1731706080;     // 15 November 2024, 21:28 UTC
constexpr std::time_t kNewMoon = 1704974220;      // 11 January 2024, 11:57 UTC
constexpr std::time_t kFirstQuarter = 1713208380; // 15 April 2024, 19:13 UTC

std::ptrdiff_t litCharacters(const std::wstring& picture)
{
    return std::count(picture.begin(), picture.end(), L'@');
}

TEST(MoonPhase, IsHalfAMonthAtTheFullMoon)
{
    EXPECT_NEAR(moon::phaseAt(kFullMoon), 0.5, kHalfADay);
}

TEST(MoonPhase, IsZeroAtTheNewMoonAndAWholeMonthJustBefore)
{
    const double phase = moon::phaseAt(kNewMoon);
    EXPECT_NEAR(phase - std::round(phase), 0, kHalfADay);
}

TEST(MoonPhase, IsAQuarterAtTheFirstQuarter)
{
    EXPECT_NEAR(moon::phaseAt(kFirstQuarter), 0.25, kHalfADay);
}

TEST(MoonPhase, CountsBackwardsFromTheKnownNewMoonToo)
{
    const double phase = moon::phaseAt(-1);
    EXPECT_GE(phase, 0);
    EXPECT_LT(phase, 1);
}

TEST(MoonPhase, HasAnIndexThatBeginsAgainBeforeTheNextNewMoon)
{
    EXPECT_EQ(moon::phaseIndex(0), 0U);
    EXPECT_EQ(moon::phaseIndex(0.25), 2U);
    EXPECT_EQ(moon::phaseIndex(0.5), 4U);
    EXPECT_EQ(moon::phaseIndex(0.99), 0U);
}

TEST(MoonPhase, IsDrawnDarkWhenNewAndLitWhenFull)
{
    EXPECT_EQ(litCharacters(moon::picture(0)), 0);
    EXPECT_EQ(moon::picture(0.5).find(L'.'), std::wstring::npos);
    EXPECT_GT(litCharacters(moon::picture(0.5)), 0);
}

TEST(MoonPhase, IsDrawnWithTheLightOnTheRightWhenWaxingAndOnTheLeftWhenWaning)
{
    const std::wstring waxing = moon::picture(0.2);
    const std::wstring waning = moon::picture(0.8);
    EXPECT_GT(waxing.rfind(L'@'), waxing.rfind(L'.'));
    EXPECT_LT(waning.rfind(L'@'), waning.rfind(L'.'));
    EXPECT_EQ(litCharacters(waxing), litCharacters(waning));
}

TEST(MoonPhase, LightsAsMuchOfThePictureAsOfTheMoon)
{
    const auto all = static_cast<double>(litCharacters(moon::picture(0.5)));
    for (const double phase : {0.1, 0.3, 0.45, 0.6, 0.9})
        EXPECT_NEAR(static_cast<double>(litCharacters(moon::picture(phase))) / all, moon::litPart(phase),
                    0.05)
            << phase;
}
} // namespace
