// A process that is killed while it rewrites a list leaves the list of before or the list of after.
#include <gtest/gtest.h>

#include <random>

#include <unistd.h>

#include "host/registry/Registry.h"
#include "tests/host/registry/StoredList.h"
#include "tests/support/BusyFor.h"
#include "tests/support/ChildProcess.h"
#include "tests/support/Database.h"
#include "tests/support/TemporaryFolder.h"

using tessel::Registry;

namespace
{
constexpr int kStoreKills = 50;
constexpr int kEntries = 40;
constexpr int kAcknowledgedBefore = 3;

// Rewrites the list over and over, every time with another number of entries, and tells each generation once
// it is stored.
void rewriteForEver(const std::filesystem::path& file, int generation, int output)
{
    Registry registry(file);
    for (;; ++generation)
    {
        if (!rewriteList(registry, generation, kEntries + generation % 7) || !registry.endOfCommand())
            _exit(1);
        const std::string line = std::to_string(generation) + "\n";
        if (write(output, line.data(), line.size()) < 0)
            _exit(1);
    }
}
} // namespace

TEST(KilledProcess, LeavesAListThatIsWhole)
{
    const TemporaryFolder folder;
    const auto file = folder / "registry.db";
    std::mt19937 random(std::random_device{}());
    int stored = 0;
    for (int kill = 0; kill < kStoreKills; ++kill)
    {
        ChildProcess child([&](int output) { rewriteForEver(file, stored + 1, output); });
        int acknowledged = 0;
        for (int i = 0; i < kAcknowledgedBefore; ++i)
            acknowledged = std::stoi("0" + child.readLine());
        ASSERT_GT(acknowledged, stored);
        busyFor(static_cast<unsigned>(random() % 20'000'000));
        child.kill();
        ASSERT_EQ(runSql(file, "PRAGMA integrity_check"), "ok") << "kill " << kill;
        Registry registry(file);
        ASSERT_EQ(registry.canStore().sentence(), L"");
        stored = generationOf(registry);
        ASSERT_GE(stored, acknowledged) << "kill " << kill;
    }
}

TEST(KilledProcess, LeavesNothingOfACommandThatHadNotEnded)
{
    const TemporaryFolder folder;
    const auto file = folder / "registry.db";
    ChildProcess child(
        [&](int output)
        {
            Registry registry(file);
            const bool written = rewriteList(registry, 1, kEntries) && registry.endOfCommand() &&
                                 rewriteList(registry, 2, kEntries);
            if (!written || write(output, "written\n", 8) < 0)
                _exit(1);
            pause();
        });
    ASSERT_EQ(child.readLine(), "written");
    child.kill();
    Registry registry(file);
    EXPECT_EQ(generationOf(registry), 1);
    EXPECT_TRUE(rewriteList(registry, 3, kEntries)) << "the killed process holds no lock";
    EXPECT_TRUE(registry.endOfCommand());
}
