// Where a window opens that remembers its place.
#pragma once

namespace ModrigUtils
{
// In points; the origin is the lower left corner.
struct Frame
{
    double x = 0;
    double y = 0;
    double width = 0;
    double height = 0;
};

// The remembered frame, or as much of it as fits the part of the screen that windows may use, which may be
// another screen than last time's; no smaller than the least size. The title bar is on the screen in any
// case.
[[nodiscard]] Frame OnScreen(Frame remembered, const Frame& screen, double leastWidth, double leastHeight);
} // namespace ModrigUtils
