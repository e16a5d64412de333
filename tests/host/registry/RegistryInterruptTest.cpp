#include <atomic>
#include <thread>

#include <gtest/gtest.h>

#include "tests/host/support/RegistryHost.h"

TEST(RegistryInterrupt, ByAnotherThreadStopsTheReadingOfManyValuesAndNothingElse)
{
    RegistryHost host;
    tessel::Registry& registry = host.registry();
    ASSERT_TRUE(registry.write(L"A", L"name", L"1"));
    ASSERT_TRUE(registry.endOfCommand());
    std::atomic<bool> over = false;
    std::thread leaning(
        [&]
        {
            while (!over)
                registry.interrupt();
        });
    int values = 0;
    while (registry.read(L"A", L"name"))
        ++values;
    over = true;
    leaning.join();
    EXPECT_GE(values, 10'000) << "nobody waits for so little";
    EXPECT_FALSE(registry.endOfCommand());
    EXPECT_EQ(registry.read(L"A", L"name"), L"1") << "the next command";
}
