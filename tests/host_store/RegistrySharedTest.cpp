// Two processes on one registry.
#include <gtest/gtest.h>

#include <memory>
#include <vector>

#include <unistd.h>

#include "host/text/Unicode.h"
#include "tests/host_store/ChildProcess.h"
#include "tests/host_store/RegistryHost.h"
#include "tests/host_store/StoredList.h"

using tessel::Registry;

TEST(SharedRegistry, ShowsAnotherProcessNothingBeforeTheCommandEnds)
{
    RegistryHost host;
    ASSERT_TRUE(rewriteList(host.registry(), 1, 10));
    ASSERT_TRUE(host.registry().endOfCommand());
    const auto seenByOther = [&host]
    {
        return askChild(
            [&host]
            {
                Registry other(host.file());
                return std::to_string(generationOf(other));
            });
    };
    ASSERT_TRUE(rewriteList(host.registry(), 2, 200));
    EXPECT_EQ(generationOf(host.registry()), 2);
    EXPECT_EQ(seenByOther(), "1");
    EXPECT_TRUE(host.registry().endOfCommand());
    EXPECT_EQ(seenByOther(), "2");
}

TEST(SharedRegistry, IsReadAnewAfterAnotherProcessWrote)
{
    RegistryHost host;
    Registry other(host.file());
    EXPECT_TRUE(host.registry().write(L"A", L"name", L"1"));
    EXPECT_TRUE(host.registry().endOfCommand());
    EXPECT_EQ(other.read(L"a", L"NAME"), L"1");
    EXPECT_TRUE(other.write(L"A", L"name", L"2"));
    EXPECT_TRUE(other.write(L"A\\B", L"name", L"2"));
    EXPECT_TRUE(other.endOfCommand());
    EXPECT_EQ(host.registry().read(L"A", L"name"), L"2");
    EXPECT_TRUE(host.registry().write(L"A\\B", L"name", L"3"));
    EXPECT_TRUE(host.registry().endOfCommand());
    EXPECT_EQ(other.read(L"A\\B", L"name"), L"3");
}

TEST(SharedRegistry, IsMadeOnceByProcessesThatStartTogether)
{
    for (int round = 0; round < 10; ++round)
    {
        const TemporaryFolder folder;
        const auto file = folder / "registry.db";
        const auto work = [&file](int output)
        {
            Registry registry(file);
            const bool done = registry.problem().empty() &&
                              registry.write(L"A", std::to_wstring(output), L"1") && registry.endOfCommand();
            const std::string line = done ? "done\n" : tessel::toUtf8(registry.problem()) + "!\n";
            if (write(output, line.data(), line.size()) < 0)
                _exit(1);
        };
        std::vector<std::unique_ptr<ChildProcess>> children;
        for (int i = 0; i < 6; ++i)
            children.push_back(std::make_unique<ChildProcess>(work));
        for (const auto& child : children)
            EXPECT_EQ(child->readLine(), "done");
        Registry registry(file);
        EXPECT_EQ(registry.subKeys(Registry::kRoot), std::vector<std::wstring>{L"A"});
        EXPECT_EQ(registry.values(registry.find(L"A")).size(), 6u)
            << "each child has a descriptor of its own";
    }
}

TEST(SharedRegistry, TakesTheCommandsOfTwoProcessesOneAfterTheOther)
{
    constexpr int kRounds = 50;
    RegistryHost host;
    const auto count = [](Registry& registry, const wchar_t* name)
    {
        bool well = true;
        for (int round = 1; well && round <= kRounds; ++round)
            well = registry.write(L"Counts", name, std::to_wstring(round)) &&
                   rewriteList(registry, round, 5) && registry.endOfCommand();
        return well;
    };
    const ChildProcess child(
        [&](int output)
        {
            Registry other(host.file());
            if (!count(other, L"child") || write(output, "done\n", 5) < 0)
                _exit(1);
        });
    EXPECT_TRUE(count(host.registry(), L"parent"));
    EXPECT_EQ(child.readLine(), "done");
    EXPECT_EQ(host.registry().read(L"Counts", L"child"), std::to_wstring(kRounds));
    EXPECT_EQ(host.registry().read(L"Counts", L"parent"), std::to_wstring(kRounds));
    EXPECT_EQ(generationOf(host.registry()), kRounds);
    EXPECT_EQ(host.output().text(), "");
}

TEST(SharedRegistry, RefusesAWriteWhileAnotherCommandTakesTooLong)
{
    RegistryHost host;
    Registry other(host.file());
    ASSERT_TRUE(other.write(L"A", L"name", L"other"));
    EXPECT_FALSE(host.registry().write(L"A", L"name", L"mine"));
    EXPECT_FALSE(host.registry().endOfCommand());
    EXPECT_EQ(host.output().text(),
              "The registry " + host.file().string() +
                  " could not be written: database is locked. What was stored before is "
                  "unchanged.\n");
    EXPECT_TRUE(other.endOfCommand());
    EXPECT_TRUE(host.registry().write(L"A", L"name", L"mine"));
    EXPECT_TRUE(host.registry().endOfCommand());
    EXPECT_EQ(other.read(L"A", L"name"), L"mine");
}
