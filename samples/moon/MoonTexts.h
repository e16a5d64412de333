// The ids of the texts in MoonRes.dll.
#pragma once

namespace moon
{
inline constexpr unsigned kFirstPhaseName = 1; // eight of them, from the new moon on
inline constexpr unsigned kGreeting = 20;
inline constexpr unsigned kTonight = 21; // name of the phase, per cent, days
inline constexpr unsigned kLocked = 22;
inline constexpr unsigned kUnlocked = 23;

// What HELP tells of the commands.
inline constexpr unsigned kShowsTheMoon = 30;
inline constexpr unsigned kLocksTheModule = 31;
inline constexpr unsigned kUnlocksTheModule = 32;
} // namespace moon
