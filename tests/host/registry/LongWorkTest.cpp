#include "host/registry/LongWork.h"

#include <chrono>
#include <thread>

#include <gtest/gtest.h>

using tessel::LongWork;

namespace
{
constexpr int kMuch = 10'001;

void countMuch(LongWork& work)
{
    for (int value = 0; value < kMuch; ++value)
        work.count();
}
} // namespace

TEST(LongWork, IsStoppedByAnotherThread)
{
    LongWork work;
    countMuch(work);
    std::thread([&] { work.interrupt(); }).join();
    EXPECT_TRUE(work.isInterrupted());
    work.end();
    EXPECT_FALSE(work.isInterrupted());
}

TEST(LongWork, IsNotStoppedByTheKeyThatWasMeantForTheWorkBefore)
{
    LongWork work;
    std::atomic<bool> over = false;
    std::thread leaning(
        [&]
        {
            while (!over)
                work.interrupt();
        });
    int wronglyStopped = 0;
    for (int round = 0; round < 500; ++round)
    {
        countMuch(work);
        work.end();
        for (int value = 0; value < 100; ++value)
            wronglyStopped += work.isInterrupted() ? 1 : 0;
    }
    over = true;
    leaning.join();
    EXPECT_EQ(wronglyStopped, 0);
}

// Of whatever kind it is: what begins shortly after other work goes on with it.
TEST(LongWork, IsToldOnceAPersonHasWaitedTwoSeconds)
{
    const auto wait = []
    {
        std::this_thread::sleep_for(std::chrono::milliseconds(1100));
    };
    LongWork work;
    work.begin();
    wait();
    EXPECT_FALSE(work.isLong());
    work.begin();
    wait();
    EXPECT_TRUE(work.isLong());
    EXPECT_FALSE(work.isLong()) << "it has just been told";
    work.end();
    work.begin();
    wait();
    EXPECT_FALSE(work.isLong()) << "another command begins again";
}
