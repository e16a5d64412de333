// Waiting for what another program does.
#pragma once

#include <chrono>
#include <thread>

inline constexpr std::chrono::seconds kPatience{15};

// Whether the condition comes true before the patience is at its end.
template <typename Condition>
bool comesTrue(const Condition& condition, std::chrono::seconds patience = kPatience)
{
    constexpr std::chrono::milliseconds kBetweenLooks{50};
    const auto deadline = std::chrono::steady_clock::now() + patience;
    while (!condition())
    {
        if (std::chrono::steady_clock::now() > deadline)
            return false;
        std::this_thread::sleep_for(kBetweenLooks);
    }
    return true;
}
