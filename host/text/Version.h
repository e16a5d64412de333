#pragma once

namespace tessel
{
inline constexpr char kVersionLine[] = "Tessel R21, reference host for Modrig";

// The registry key below which the host and its applications keep what they store.
inline constexpr wchar_t kProductRegistryRoot[] = L"Software\\Tessel\\R21";
} // namespace tessel
