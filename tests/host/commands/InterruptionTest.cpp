#include "host/commands/Interruption.h"

#include <thread>

#include <gtest/gtest.h>

using tessel::EndRequest;
using tessel::Interruption;

TEST(Interruption, ByAnotherThreadIsSeenByWhoeverAsksAgainAndAgain)
{
    const EndRequest endRequest;
    Interruption interruption(endRequest);
    const Interruption::Work work(interruption);
    const Interruption::Wish wish(interruption);
    EXPECT_FALSE(wish.isThere());
    std::thread other([&] { EXPECT_FALSE(interruption.press(1)); });
    while (!wish.isThere())
        std::this_thread::yield();
    other.join();
    EXPECT_FALSE(Interruption::Wish(interruption).isThere());
}

TEST(Interruption, MayComeWhileWorkBeginsAndEnds)
{
    const EndRequest endRequest;
    Interruption interruption(endRequest);
    std::atomic<bool> over = false;
    std::thread other(
        [&]
        {
            while (!over)
                interruption.press(0);
        });
    for (int round = 0; round < 10'000; ++round)
        const Interruption::Work work(interruption);
    over = true;
    other.join();
    for (int press = 0; press < 10; ++press)
        EXPECT_FALSE(interruption.press(0)) << "nobody is at work";
}

TEST(Interruption, ByTheWishForTheEndOnAnotherThreadIsSeen)
{
    EndRequest endRequest;
    const Interruption interruption(endRequest);
    const Interruption::Wish wish(interruption);
    std::thread other([&] { endRequest.make(); });
    while (!wish.isThere())
        std::this_thread::yield();
    other.join();
}
