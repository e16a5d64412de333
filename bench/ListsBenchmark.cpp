// The History in the registry, against the same registry calls made bare and against the same rows by the
// store alone; looking an application up; memory.
#include <benchmark/benchmark.h>
#include <malloc.h>
#include <wincompat/winreg.h>

#include <cwchar>
#include <filesystem>
#include <memory>
#include <set>
#include <string>
#include <vector>

#include "bench/BareStore.h"
#include "bench/Child.h"
#include "bench/Ratios.h"
#include "bench/Session.h"
#include "modrig/lists/Globals.h"
#include "modrig/lists/History.h"
#include "modrig/lists/ListMembership.h"
#include "modrig/profile/ProfileRegistry.h"

namespace
{
constexpr std::size_t kFew = 1'000;
constexpr std::size_t kMany = 100'000;
constexpr int kListRepetitions = 7;
constexpr int kFewRepetitions = 31; // short ones are noisy
constexpr DWORD kBufferCharacters = 1024;

std::wstring pathOf(std::size_t number)
{
    return L"/home/user/Applications/library" + std::to_wstring(number / 100) + L"/tool" +
           std::to_wstring(number) + L".lsp";
}

void fill(CStringList& list, std::size_t count)
{
    list.RemoveAll();
    for (std::size_t i = 0; i < count; ++i)
        list.AddTail(pathOf(i));
}

std::wstring historyKey()
{
    return ModrigUtils::GetModrigProfileRegKey().Text() + L"\\History";
}

std::wstring entryName(std::size_t index)
{
    return std::to_wstring(index) + L"History";
}

bool bareRead(const std::wstring& key, const std::wstring& name, std::wstring& data)
{
    HKEY handle = nullptr;
    if (RegOpenKeyExW(HKEY_CURRENT_USER, key.c_str(), 0, KEY_READ, &handle) != ERROR_SUCCESS)
        return false;
    wchar_t buffer[kBufferCharacters] = {};
    DWORD type = REG_SZ;
    DWORD size = sizeof buffer;
    const bool read = tsRegGetValue(handle, name.c_str(), 0, &type, buffer, &size) == ERROR_SUCCESS;
    RegCloseKey(handle);
    data = buffer;
    return read;
}

HKEY bareCreate(const std::wstring& key)
{
    HKEY handle = nullptr;
    RegCreateKeyEx(HKEY_CURRENT_USER, key.c_str(), 0, nullptr, 0, KEY_WRITE, nullptr, &handle, nullptr);
    return handle;
}

void bareWrite(const std::wstring& key, const std::wstring& name, const std::wstring& data)
{
    const HKEY handle = bareCreate(key);
    tsudRegSetString(handle, name.c_str(), data.c_str());
    RegCloseKey(handle);
}

std::vector<std::wstring> bareNames(const std::wstring& key)
{
    std::vector<std::wstring> names;
    HKEY handle = nullptr;
    RegOpenKeyExW(HKEY_CURRENT_USER, key.c_str(), 0, KEY_READ, &handle);
    wchar_t name[kBufferCharacters] = {};
    for (DWORD index = 0;; ++index)
    {
        DWORD length = kBufferCharacters;
        if (RegEnumValueW(handle, index, name, &length, nullptr, nullptr, nullptr, nullptr) != ERROR_SUCCESS)
            break;
        names.emplace_back(name);
    }
    RegCloseKey(handle);
    return names;
}

bool bareReadAll(std::size_t count)
{
    const std::wstring key = historyKey();
    std::wstring data;
    bool all = true;
    for (std::size_t i = 1; i <= count; ++i)
        all = bareRead(key, entryName(i), data) && all;
    return all;
}

// The calls that storing a list makes, and nothing between them.
void bareWriteAll(const std::vector<std::wstring>& paths)
{
    const std::wstring key = historyKey();
    for (const std::wstring& name : bareNames(key))
    {
        const HKEY handle = bareCreate(key);
        RegDeleteValueW(handle, name.c_str());
        RegCloseKey(handle);
    }
    bareWrite(key, L"NumHistory", std::to_wstring(paths.size()));
    for (std::size_t i = 0; i < paths.size(); ++i)
        bareWrite(key, entryName(i + 1), paths[i]);
}

std::vector<std::wstring> pathsUpTo(std::size_t count)
{
    std::vector<std::wstring> paths;
    for (std::size_t i = 0; i < count; ++i)
        paths.push_back(pathOf(i));
    return paths;
}

std::string utf8PathOf(std::size_t number)
{
    const std::wstring path = pathOf(number);
    return {path.begin(), path.end()};
}

std::filesystem::path registryFile()
{
    return bench::workFolder() / "profile" / "registry.db";
}

std::filesystem::path bareFile(std::size_t count)
{
    return bench::workFolder() / ("bare" + std::to_string(count) + ".db");
}

// Whether the last of so many entries is stored.
bool isStored(std::size_t count)
{
    std::wstring data;
    return bareRead(historyKey(), entryName(count), data) && data == pathOf(count - 1);
}

bool storeAll(std::size_t count)
{
    ModrigUtils::WriteHistoryFilesToRegistry();
    bench::endCommand();
    return isStored(count);
}

// Makes a History of that size the stored one: each size has a profile of its own, so that it is written only
// once for all the runs that begin with it.
void store(std::size_t count)
{
    bench::useProfile(L"History" + std::to_wstring(count));
    static std::set<std::size_t> stored;
    if (gHistoryList.GetCount() != count)
        fill(gHistoryList, count);
    if (!stored.insert(count).second)
        return;
    ModrigUtils::WriteHistoryFilesToRegistry();
    bench::endCommand();
}

// `prepare` is not timed; `work` answers whether it has done what it should.
void measure(const std::string& name, int repetitions, std::function<void()> prepare,
             std::function<bool()> work)
{
    benchmark::RegisterBenchmark(
        name.c_str(),
        [prepare = std::move(prepare), work = std::move(work)](benchmark::State& state)
        {
            for (auto iteration : state)
            {
                static_cast<void>(iteration);
                prepare();
                bool done = false;
                state.SetIterationTime(bench::secondsOf([&] { done = work(); }));
                if (!done)
                    state.SkipWithError("the stored list does not hold what it should");
            }
        })
        ->UseManualTime()
        ->Iterations(1)
        ->Repetitions(repetitions);
}

void addHistory(std::size_t count, int repetitions)
{
    const std::string of = " " + std::to_string(count) + " of History";
    const std::vector<std::wstring> paths = pathsUpTo(count);
    const auto prepare = [count]
    {
        store(count);
    };
    measure("read" + of, repetitions, prepare,
            [count]
            {
                ModrigUtils::InitializeHistoryFiles();
                return gHistoryList.GetCount() == count;
            });
    measure("read" + of + ", bare calls", repetitions, prepare, [count] { return bareReadAll(count); });
    measure("write" + of, repetitions, prepare, [count] { return storeAll(count); });
    measure("write" + of + ", bare calls", repetitions, prepare,
            [paths]
            {
                bareWriteAll(paths);
                bench::endCommand();
                return isStored(paths.size());
            });
}

void emptyTheHistory()
{
    bench::useProfile(L"EmptyHistory");
    gHistoryList.RemoveAll();
    ModrigUtils::WriteHistoryFilesToRegistry();
    bench::endCommand();
    fill(gHistoryList, kMany);
}

// What the store needs for the same rows, when nothing stands between them and it.
void addStoreAlone()
{
    const std::string of = " " + std::to_string(kMany) + " of History";
    measure(
        "read" + of + ", store alone", kListRepetitions, [] { store(kMany); },
        [] { return bench::readBare(registryFile(), kMany); });
    const auto prepare = []
    {
        store(kMany);
        static const bool made = bench::makeBare(registryFile(), bareFile(kMany)) &&
                                 bench::writeBare(bareFile(kMany), kMany, false, utf8PathOf);
        static_cast<void>(made); // what is not there cannot be removed: the writing says so
    };
    measure("write" + of + ", store alone", kListRepetitions, prepare,
            [] { return bench::writeBare(bareFile(kMany), kMany, true, utf8PathOf); });
    measure("write" + of + ", none before", kListRepetitions, emptyTheHistory,
            [] { return storeAll(kMany); });
    measure(
        "write" + of + ", none before, store alone", kListRepetitions,
        [] { static_cast<void>(bench::makeBare(registryFile(), bareFile(0))); },
        [] { return bench::writeBare(bareFile(0), kMany, false, utf8PathOf); });
}

void addStoreRatios()
{
    const std::string of = " " + std::to_string(kMany) + " of History";
    for (const std::string& work : {"read" + of, "write" + of, "write" + of + ", none before"})
        bench::addRatio({work + " / store alone", work, work + ", store alone", 2});
}

void addHistoryRatios(const std::string& verb)
{
    const std::string many = verb + " " + std::to_string(kMany) + " of History";
    const std::string few = verb + " " + std::to_string(kFew) + " of History";
    bench::addRatio({many + " / bare registry calls", many, many + ", bare calls", 2});
    bench::addRatio({verb + " History, cost per entry at 100000 / at 1000", many, few, 1.5, kMany, kFew});
}

// Looks a thousand paths up; every second time they differ in case from those in the list.
void addLookup(const std::string& name, std::size_t count, std::size_t firstAsked)
{
    auto list = std::make_shared<CStringList>();
    fill(*list, count);
    std::vector<CStdStr> asked;
    for (std::size_t i = 0; i < kFew; ++i)
        asked.emplace_back(pathOf(firstAsked + i * (count / kFew)));
    benchmark::RegisterBenchmark(name.c_str(),
                                 [list, asked](benchmark::State& state)
                                 {
                                     std::size_t next = 0;
                                     for (auto iteration : state)
                                     {
                                         static_cast<void>(iteration);
                                         benchmark::DoNotOptimize(ModrigUtils::FoundinSpecificList(
                                             asked[next++ % asked.size()], *list));
                                     }
                                 })
        ->Repetitions(kListRepetitions)
        ->MinTime(0.05);
}

void addLookups()
{
    for (const std::size_t count : {kFew, kMany})
    {
        const std::string size = std::to_string(count);
        addLookup("look up, hit, list of " + size, count, 0);
        addLookup("look up, miss, list of " + size, count, count);
    }
    benchmark::RegisterBenchmark("two microseconds",
                                 [](benchmark::State& state)
                                 {
                                     for (auto iteration : state)
                                     {
                                         static_cast<void>(iteration);
                                         state.SetIterationTime(2e-6);
                                     }
                                 })
        ->UseManualTime()
        ->Iterations(1);
    for (const std::string kind : {"hit", "miss"})
    {
        const std::string many = "look up, " + kind + ", list of 100000";
        bench::addRatio({many + " / 2 microseconds", many, "two microseconds", 1});
        bench::addRatio(
            {"look up, " + kind + ", at 100000 / at 1000", many, "look up, " + kind + ", list of 1000", 2});
    }
}

// Bytes that the allocator has handed out for a list of entries, against the bytes of their paths.
void addMemory()
{
    std::size_t pathBytes = 0;
    for (std::size_t i = 0; i < kMany; ++i)
        pathBytes += pathOf(i).size() * sizeof(wchar_t);
    CStringList list;
    const struct mallinfo2 before = mallinfo2();
    fill(list, kMany);
    const struct mallinfo2 after = mallinfo2();
    const auto bytes = static_cast<double>(after.uordblks + after.hblkhd - before.uordblks - before.hblkhd);
    bench::addFigure("memory of a list entry / bytes of its path", bytes / static_cast<double>(pathBytes),
                     "x", 3);
}
} // namespace

void addListBenchmarks()
{
    bench::startHost();
    addHistory(kFew, kFewRepetitions);
    addHistory(kMany, kListRepetitions);
    addStoreAlone();
    addStoreRatios();
    addHistoryRatios("read");
    addHistoryRatios("write");
    addLookups();
    addMemory();
}
