// Two processes on one registry.
#include <gtest/gtest.h>

#include <chrono>
#include <filesystem>
#include <fstream>
#include <memory>
#include <set>
#include <vector>

#include <sqlite3.h>
#include <unistd.h>

#include <tessel/tssession.h>
#include <wincompat/winreg.h>

#include "host/text/Unicode.h"
#include "tests/host/registry/StoredList.h"
#include "tests/host/support/RegistryHost.h"
#include "tests/support/ChildProcess.h"

using tessel::Registry;

namespace
{
constexpr std::chrono::milliseconds kShortTimeout{50};
} // namespace

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

TEST(SharedRegistry, IsReadAgainAfterAnotherProcessWrote)
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
            const bool done = registry.canStore() && registry.write(L"A", std::to_wstring(output), L"1") &&
                              registry.endOfCommand();
            const std::string line = done ? "done\n" : tessel::toUtf8(registry.canStore().sentence()) + "!\n";
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

namespace
{
HKEY openForWriting(const wchar_t* path)
{
    HKEY key = nullptr;
    EXPECT_EQ(RegCreateKeyEx(HKEY_CURRENT_USER, path, 0, nullptr, 0, KEY_WRITE, nullptr, &key, nullptr),
              ERROR_SUCCESS);
    return key;
}

// Whether another process can write now.
bool isFree(const std::filesystem::path& file)
{
    sqlite3* database = nullptr;
    sqlite3_open(file.c_str(), &database);
    const bool begun = sqlite3_exec(database, "BEGIN IMMEDIATE", nullptr, nullptr, nullptr) == SQLITE_OK;
    sqlite3_close(database);
    return begun;
}

// Rewrites the list by the calls that a module has: keys that are opened and closed for each of them, names
// that are listed and then deleted one by one. False when one of them answers an error.
bool rewriteByCalls(int generation, int count)
{
    RegCloseKey(openForWriting(kListKey));
    HKEY key = nullptr;
    bool well = RegOpenKeyExW(HKEY_CURRENT_USER, kListKey, 0, KEY_READ, &key) == ERROR_SUCCESS;
    std::vector<std::wstring> names;
    wchar_t name[100];
    for (DWORD length = 100; RegEnumValueW(key, static_cast<DWORD>(names.size()), name, &length, nullptr,
                                           nullptr, nullptr, nullptr) == ERROR_SUCCESS;
         length = 100)
        names.emplace_back(name);
    RegCloseKey(key);
    for (const auto& stored : names)
    {
        key = openForWriting(kListKey);
        well = well && RegDeleteValueW(key, stored.c_str()) == ERROR_SUCCESS;
        RegCloseKey(key);
    }
    return well && writeList(*tessel::running<Registry>(), generation, count);
}
} // namespace

TEST(SharedRegistry, IsLockedFromTheFirstLookIntoAKeyThatIsOpenedForWriting)
{
    RegistryHost host;
    ASSERT_TRUE(host.registry().write(L"A", L"name", L"1"));
    ASSERT_TRUE(host.registry().write(L"B", L"name", L"1"));
    ASSERT_TRUE(host.registry().endOfCommand());
    const HKEY key = openForWriting(L"A");
    EXPECT_TRUE(isFree(host.file())) << "a key that is only made sure of keeps nobody waiting";
    EXPECT_EQ(host.registry().read(L"B", L"name"), L"1");
    EXPECT_TRUE(isFree(host.file())) << "another key";
    wchar_t name[10];
    DWORD length = 10;
    EXPECT_EQ(RegEnumValueW(key, 0, name, &length, nullptr, nullptr, nullptr, nullptr), ERROR_SUCCESS);
    EXPECT_FALSE(isFree(host.file()));
    EXPECT_TRUE(host.registry().endOfCommand());
    EXPECT_TRUE(isFree(host.file()));
    EXPECT_EQ(host.registry().read(L"A", L"name"), L"1");
    EXPECT_TRUE(isFree(host.file())) << "the command that opened it is over";
    openForWriting(L"A");
    EXPECT_EQ(host.registry().read(L"A", L"name"), L"1");
    EXPECT_FALSE(isFree(host.file())) << "a value is a look as well";
}

TEST(SharedRegistry, KeepsAListWholeThatTwoProcessesRewriteByCalls)
{
    constexpr std::size_t kEnough = 20;
    RegistryHost host;
    const auto enough = host.file().parent_path() / "enough";
    ASSERT_TRUE(rewriteList(host.registry(), 1, 3));
    ASSERT_TRUE(host.registry().endOfCommand());
    const auto rewriteUntilEnough = [&](int offset)
    {
        return [&host, &enough, offset](int output)
        {
            host.open(); // a connection belongs to the process that made it
            bool well = true;
            for (int round = 1; !std::filesystem::exists(enough); ++round)
            {
                // As with a module, a list that failed is no reason not to end the command.
                well = rewriteByCalls(offset + round, round * 7 % 30) && well;
                well = host.registry().endOfCommand() && well;
            }
            if (write(output, well ? "well\n" : "failed\n", well ? 5 : 7) < 0)
                _exit(1);
        };
    };
    host.close();
    const ChildProcess first(rewriteUntilEnough(1'000'000));
    const ChildProcess second(rewriteUntilEnough(2'000'000));
    host.open();
    std::set<int> seenOfFirst;
    std::set<int> seenOfSecond;
    while (seenOfFirst.size() < kEnough || seenOfSecond.size() < kEnough)
    {
        const int seen = generationInOneLook(host.file());
        ASSERT_GT(seen, 0) << "after " << seenOfFirst.size() + seenOfSecond.size() << " whole ones";
        (seen > 2'000'000 ? seenOfSecond : seenOfFirst).insert(seen);
    }
    std::ofstream(enough).put('\n');
    EXPECT_EQ(first.readLine(), "well");
    EXPECT_EQ(second.readLine(), "well");
}

TEST(SharedRegistry, IsReadAsItStoodAtOneMomentOfACommand)
{
    RegistryHost host;
    Registry other(host.file());
    ASSERT_TRUE(other.write(L"A", L"one", L"old"));
    ASSERT_TRUE(other.write(L"A", L"two", L"old"));
    ASSERT_TRUE(other.endOfCommand());
    EXPECT_EQ(host.registry().read(L"A", L"one"), L"old");
    ASSERT_TRUE(other.write(L"A", L"two", L"new"));
    ASSERT_TRUE(other.endOfCommand());
    EXPECT_EQ(host.registry().read(L"A", L"two"), L"old");
    host.registry().storeSoFar();
    EXPECT_EQ(host.registry().read(L"A", L"two"), L"new");
    ASSERT_TRUE(other.write(L"A", L"two", L"newer"));
    ASSERT_TRUE(other.endOfCommand());
    EXPECT_TRUE(host.registry().write(L"B", L"name", L"1")) << "although another one has written since";
    EXPECT_EQ(host.registry().read(L"A", L"two"), L"newer");
    EXPECT_TRUE(host.registry().endOfCommand());
    EXPECT_EQ(other.read(L"B", L"name"), L"1");
}

TEST(SharedRegistry, StoresWhatWasWrittenBeforeAWait)
{
    RegistryHost host;
    ASSERT_TRUE(host.registry().write(L"A", L"name", L"1"));
    EXPECT_FALSE(isFree(host.file()));
    tsrxBeforeWaiting(true);
    EXPECT_TRUE(isFree(host.file()));
    ASSERT_TRUE(host.registry().write(L"A", L"name", L"2"));
    tsrxBeforeWaiting(false);
    EXPECT_TRUE(isFree(host.file()));
    Registry other(host.file());
    EXPECT_EQ(other.read(L"A", L"name"), L"2");
}

TEST(SharedRegistry, ForgetsAFailureWhenTheActionIsOverAndNotBefore)
{
    RegistryHost host(kShortTimeout);
    Registry other(host.file());
    ASSERT_TRUE(other.write(L"A", L"name", L"other"));
    EXPECT_FALSE(host.registry().write(L"A", L"name", L"mine"));
    EXPECT_TRUE(other.endOfCommand());
    tsrxBeforeWaiting(false);
    EXPECT_EQ(host.output().text(), "");
    EXPECT_FALSE(host.registry().write(L"A", L"name", L"mine")) << "a part of what failed";
    tsrxBeforeWaiting(true);
    EXPECT_NE(host.output().text().find("could not be written: another program holds it"), std::string::npos);
    EXPECT_TRUE(host.registry().write(L"A", L"name", L"mine"));
    tsrxBeforeWaiting(true);
    EXPECT_EQ(other.read(L"A", L"name"), L"mine");
}

TEST(SharedRegistry, RefusesAWriteWhileAnotherCommandTakesTooLong)
{
    RegistryHost host(kShortTimeout);
    Registry other(host.file());
    ASSERT_TRUE(other.write(L"A", L"name", L"other"));
    EXPECT_FALSE(host.registry().write(L"A", L"name", L"mine"));
    EXPECT_FALSE(host.output().commandLine().tell(host.registry().endOfCommand()));
    EXPECT_EQ(host.output().text(),
              "The registry " + host.file().string() +
                  " could not be written: another program holds it. What was stored before is unchanged. "
                  "Close that program, or let it finish, and try again.\n");
    EXPECT_TRUE(other.endOfCommand());
    EXPECT_TRUE(host.registry().write(L"A", L"name", L"mine"));
    EXPECT_TRUE(host.registry().endOfCommand());
    EXPECT_EQ(other.read(L"A", L"name"), L"mine");
}

TEST(SharedRegistry, WaitsForAnotherCommandAsLongAsItIsTold)
{
    RegistryHost host(kShortTimeout);
    Registry other(host.file());
    ASSERT_TRUE(other.write(L"A", L"name", L"other"));
    const auto begin = std::chrono::steady_clock::now();
    EXPECT_FALSE(host.registry().write(L"A", L"name", L"mine"));
    const auto waited = std::chrono::steady_clock::now() - begin;
    EXPECT_GE(waited, kShortTimeout);
    EXPECT_LT(waited, Registry::kBusyTimeout);
}

TEST(SharedRegistry, WaitsInEachCommandAgain)
{
    RegistryHost host(kShortTimeout);
    Registry other(host.file());
    ASSERT_TRUE(other.write(L"A", L"name", L"other"));
    for (int command = 0; command < 3; ++command)
    {
        const auto begin = std::chrono::steady_clock::now();
        EXPECT_FALSE(host.registry().write(L"A", L"name", L"mine"));
        EXPECT_GE(std::chrono::steady_clock::now() - begin, kShortTimeout) << command;
        EXPECT_FALSE(host.registry().endOfCommand());
    }
}

// A key that was pressed at the start is no reason to lose what is stored at the end.
TEST(SharedRegistry, WaitsInASessionWhateverSomebodyWishedAtItsStart)
{
    const TemporaryFolder folder;
    Registry registry(folder / "registry.db", kShortTimeout, {}, [] { return true; });
    Registry other(folder / "registry.db");
    ASSERT_TRUE(other.write(L"A", L"name", L"other"));
    const auto begin = std::chrono::steady_clock::now();
    EXPECT_FALSE(registry.write(L"A", L"name", L"mine"));
    EXPECT_GE(std::chrono::steady_clock::now() - begin, kShortTimeout);
}
