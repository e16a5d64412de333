// When a load that takes long says so, and when it looks whether somebody wants it to stop.
#pragma once

#include <chrono>

namespace ModrigUtils
{
class LoadProgress
{
public:
    using Time = std::chrono::steady_clock::time_point;

    explicit LoadProgress(Time start);

    // Whether it is time to look for the key that stops the load. A look costs more than loading most files
    // does, so there are not many of them; short loads see none.
    [[nodiscard]] bool IsTimeToLook(Time now);

    // Whether it is time to say how far the load has come: after a second, and then a few times a second.
    [[nodiscard]] bool IsTimeToTell(Time now);

private:
    Time mNextLook;
    Time mNextCount;
};
} // namespace ModrigUtils
