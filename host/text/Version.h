#pragma once

namespace tessel
{
inline constexpr char kVersionLine[] = "Tessel R21, reference host for Modrig";
}
