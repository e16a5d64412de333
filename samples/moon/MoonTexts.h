// The ids of the texts in MoonRes.dll.
#pragma once

namespace moon
{
inline constexpr unsigned kFirstPhaseName = 1; // eight of them, from the new moon on
inline constexpr unsigned kGreeting = 20;
inline constexpr unsigned kTonight = 21; // name of the phase, per cent, days
inline constexpr unsigned kLocked = 22;
inline constexpr unsigned kUnlocked = 23;
} // namespace moon
