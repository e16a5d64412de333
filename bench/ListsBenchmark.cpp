// The History in the registry, against the same registry calls made bare and against the same rows by the
// store alone; looking an application up; memory.
#include <benchmark/benchmark.h>
#include <malloc.h>
#include <wincompat/winreg.h>

#include <algorithm>
#include <cwchar>
#include <filesystem>
#include <functional>
#include <map>
#include <memory>
#include <set>
#include <string>
#include <vector>

#include "bench/BareStore.h"
#include "bench/Child.h"
#include "bench/ListPeers.h"
#include "bench/Ratios.h"
#include "bench/Session.h"
#include "modrig/lists/Globals.h"
#include "modrig/lists/History.h"
#include "modrig/lists/ListMembership.h"
#include "modrig/profile/ProfileRegistry.h"

namespace
{
constexpr std::size_t kFew = 1'000;
constexpr std::size_t kTwiceAsFew = 2 * kFew;
constexpr std::size_t kMany = 100'000;
constexpr std::size_t kMost = 1'000'000;
constexpr int kListRepetitions = 7;
constexpr int kMostRepetitions = 3; // seconds each
constexpr int kFewRepetitions = 31; // short ones are noisy

// What was measured and a tenth.
constexpr double kReadToStore = 0.7;
constexpr double kWriteToStore = 0.75;
constexpr double kWriteNewToStore = 0.8;
constexpr double kWriteSameToStore = 0.4;

constexpr DWORD kBufferCharacters = 1024;

// Lists of an even and an odd generation have no path in common.
std::wstring pathOf(std::size_t number, unsigned generation = 0)
{
    return L"/home/user/Applications/library" + std::to_wstring(number / 100) +
           (generation % 2 == 0 ? L"/tool" : L"/task") + std::to_wstring(number) + L".lsp";
}

void fill(CStringList& list, std::size_t count, unsigned generation = 0)
{
    list.RemoveAll();
    for (std::size_t i = 0; i < count; ++i)
        list.AddTail(pathOf(i, generation));
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

std::vector<std::wstring> pathsOf(const CStringList& list)
{
    std::vector<std::wstring> paths;
    for (const CStdStr& path : list)
        paths.push_back(path.Text());
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

// Whether the last of so many entries is stored.
bool isStored(std::size_t count, unsigned generation)
{
    std::wstring data;
    return bareRead(historyKey(), entryName(count), data) && data == pathOf(count - 1, generation);
}

bool storeAll(std::size_t count, unsigned generation = 0)
{
    ModrigUtils::WriteHistoryFilesToRegistry();
    bench::endCommand();
    return isStored(count, generation);
}

// Makes a History of that size the stored one: each size has a profile of its own, so that it is written only
// once for all the runs that begin with it.
void store(std::size_t count)
{
    bench::useProfile(L"History" + std::to_wstring(count));
    static std::set<std::size_t> stored;
    if (!stored.insert(count).second)
        return;
    fill(gHistoryList, count);
    ModrigUtils::WriteHistoryFilesToRegistry();
    bench::endCommand();
}

// The same, and the list in memory is another one in all its paths; answers its generation.
unsigned prepareOthers(std::size_t count)
{
    store(count);
    static std::map<std::size_t, unsigned> generations;
    const unsigned generation = ++generations[count];
    fill(gHistoryList, count, generation);
    return generation;
}

// `work` prepares what it needs, and answers the seconds that the rest took; negative when it has not done
// what it should.
void measureSeconds(const std::string& name, int repetitions, std::function<double()> work)
{
    benchmark::RegisterBenchmark(name.c_str(),
                                 [work = std::move(work)](benchmark::State& state)
                                 {
                                     for (auto iteration : state)
                                     {
                                         static_cast<void>(iteration);
                                         const double seconds = work();
                                         state.SetIterationTime(seconds);
                                         if (seconds < 0)
                                             state.SkipWithError(
                                                 "the stored list does not hold what it should");
                                     }
                                 })
        ->UseManualTime()
        ->Iterations(1)
        ->Repetitions(bench::repetitions(repetitions));
}

double secondsIfDone(const std::function<bool()>& work)
{
    bool done = false;
    const double seconds = bench::secondsOf([&] { done = work(); });
    return done ? seconds : -1;
}

// `prepare` is not timed; `work` answers whether it has done what it should.
void measure(const std::string& name, int repetitions, std::function<void()> prepare,
             std::function<bool()> work)
{
    measureSeconds(name, repetitions,
                   [prepare = std::move(prepare), work = std::move(work)]
                   {
                       prepare();
                       return secondsIfDone(work);
                   });
}

std::string ofHistory(std::size_t count)
{
    return " " + std::to_string(count) + " of History";
}

double secondsToRead(std::size_t count)
{
    store(count);
    gHistoryList.RemoveAll(); // a start begins with nothing to remove
    return secondsIfDone(
        [count]
        {
            ModrigUtils::InitializeHistoryFiles();
            return gHistoryList.GetCount() == count;
        });
}

double secondsToWriteOthers(std::size_t count)
{
    const unsigned generation = prepareOthers(count);
    return secondsIfDone([=] { return storeAll(count, generation); });
}

double secondsToWriteOthersBare(std::size_t count)
{
    const unsigned generation = prepareOthers(count);
    const std::vector<std::wstring> paths = pathsOf(gHistoryList);
    return secondsIfDone(
        [&]
        {
            bareWriteAll(paths);
            bench::endCommand();
            return isStored(count, generation);
        });
}

// Writing is over as many others: what it costs when every value is another one.
void addHistory(std::size_t count, int repetitions)
{
    const std::string of = ofHistory(count);
    measureSeconds("read" + of, repetitions, [count] { return secondsToRead(count); });
    measureSeconds("write" + of, repetitions, [count] { return secondsToWriteOthers(count); });
}

void addBareCalls()
{
    const std::string of = ofHistory(kMany) + ", bare calls";
    measure(
        "read" + of, kListRepetitions, [] { store(kMany); }, [] { return bareReadAll(kMany); });
    measureSeconds("write" + of, kListRepetitions, [] { return secondsToWriteOthersBare(kMany); });
}

// The least of several: what comes between is no part of it, and the two are to be taken from each other.
double leastSeconds(double (*seconds)(std::size_t), std::size_t count)
{
    constexpr int kTimes = 5;
    double least = seconds(count);
    for (int time = 1; time < kTimes && least >= 0; ++time)
        least = std::min(least, seconds(count));
    return least;
}

// What a thousand entries cost beside another thousand: free of what any list costs, however short.
void addSecondThousand()
{
    const auto difference = [](double (*seconds)(std::size_t))
    {
        const double few = leastSeconds(seconds, kFew);
        const double more = leastSeconds(seconds, kTwiceAsFew);
        return few < 0 || more < 0 ? -1 : more - few;
    };
    measureSeconds("read a second 1000 of History", kFewRepetitions,
                   [=] { return difference(secondsToRead); });
    measureSeconds("write a second 1000 of History", kFewRepetitions,
                   [=] { return difference(secondsToWriteOthers); });
}

void emptyTheHistory()
{
    bench::useProfile(L"EmptyHistory");
    gHistoryList.RemoveAll();
    ModrigUtils::WriteHistoryFilesToRegistry();
    bench::endCommand();
    fill(gHistoryList, kMany);
}

void theSameHistory()
{
    bench::useProfile(L"SameHistory");
    fill(gHistoryList, kMany);
    static const bool stored = storeAll(kMany);
    static_cast<void>(stored); // what is not there then is stored next, which says so
}

std::filesystem::path bareFile(const std::string& name)
{
    return bench::workFolder() / (name + ".db");
}

bool readStoreAlone()
{
    static bench::BareStore registry(registryFile());
    return registry.read(kMany);
}

double secondsToWriteStoreAlone()
{
    const auto file = bareFile("as-many-before");
    static const bool made = bench::makeBare(registryFile(), file);
    static bench::BareStore bare(file);
    static const bool filled = made && bare.write(kMany, false, utf8PathOf);
    return filled ? secondsIfDone([] { return bare.write(kMany, true, utf8PathOf); }) : -1;
}

double secondsToWriteStoreAloneNoneBefore()
{
    const auto file = bareFile("none-before");
    if (!bench::makeBare(registryFile(), file))
        return -1;
    bench::BareStore bare(file);
    return secondsIfDone([&] { return bare.write(kMany, false, utf8PathOf); });
}

// What the store needs for the same rows, when nothing stands between them and it: read by one prepared
// statement in one transaction, and removed one by one and inserted one by one in another.
void addStoreAlone()
{
    const std::string of = ofHistory(kMany);
    measure(
        "read" + of + ", store alone", kListRepetitions, [] { store(kMany); }, readStoreAlone);
    measureSeconds("write" + of + ", store alone", kListRepetitions,
                   []
                   {
                       store(kMany);
                       return secondsToWriteStoreAlone();
                   });
    measure("write" + of + ", none before", kListRepetitions, emptyTheHistory,
            [] { return storeAll(kMany); });
    measureSeconds("write" + of + ", none before, store alone", kListRepetitions,
                   secondsToWriteStoreAloneNoneBefore);
    measure("write" + of + ", the same before", kListRepetitions, theSameHistory,
            [] { return storeAll(kMany); });
}

void addStoreRatio(const std::string& what, const std::string& measured, const std::string& base, double most,
                   const std::string& how)
{
    bench::addRatio({.what = what, .measured = measured, .base = base, .most = most, .how = how});
}

void addStoreRatios()
{
    const std::string read = "read" + ofHistory(kMany);
    const std::string write = "write" + ofHistory(kMany);
    const std::string none = write + ", none before";
    addStoreRatio(read + " / store alone", read, read + ", store alone", kReadToStore,
                  "Bare SQLite looks each row up by its name, with one prepared statement in one "
                  "transaction, in the same file, which is open before. The module's reading also "
                  "checks the rows' checksums and looks every path up in the list.");
    addStoreRatio(write + " over others / store alone", write, write + ", store alone", kWriteToStore,
                  "As many other paths were stored before. Bare SQLite deletes their rows one by one "
                  "and inserts the new ones one by one, in one transaction and with full "
                  "synchronisation. The module asks for the same, and for the names before; the "
                  "registry changes the rows in their places.");
    addStoreRatio(none + " / store alone", none, none + ", store alone", kWriteNewToStore,
                  "Nothing was stored before. Bare SQLite inserts one by one, the registry many rows "
                  "by one statement.");
    addStoreRatio(write + " over the same / store alone, others", write + ", the same before",
                  write + ", store alone", kWriteSameToStore,
                  "What closing the dialog does when no list has changed. Bare SQLite deletes and "
                  "inserts all the same.");
}

void addHistoryRatios(const std::string& verb, double mostToCalls, double mostToFew, double mostToSecond)
{
    const std::string many = verb + ofHistory(kMany);
    const std::string most = verb + ofHistory(kMost);
    bench::addRatio({many + " / bare registry calls", many, many + ", bare calls", mostToCalls});
    bench::addRatio({verb + " History, cost per entry at 1000000 / at 1000", most, verb + ofHistory(kFew),
                     mostToFew, kMost, kFew});
    bench::addRatio({.what = verb + " History, cost per entry at 1000000 / of a second 1000",
                     .measured = most,
                     .base = verb + " a second 1000 of History",
                     .most = mostToSecond,
                     .measuredUnits = kMost,
                     .baseUnits = kFew,
                     .how = "A list of 2000 less one of 1000, each the least of five: free of what a list of "
                            "any length costs, which makes short ones dearer by the entry. Of a million "
                            "neither the list nor its index lies in the processor's caches, and the system "
                            "has to find memory for each entry."});
}

// Others read and store a file of their own that is new to this process: they keep in memory what they have
// seen.
std::filesystem::path newFile()
{
    static int files = 0;
    return bench::workFolder() / ("peer" + std::to_string(++files));
}

void addPeer(const std::string& peer,
             bool (*storeList)(const std::filesystem::path&, std::size_t, bench::PathOf),
             bool (*readList)(const std::filesystem::path&, std::size_t), double most, const std::string& why)
{
    const std::string read = "read" + ofHistory(kMany);
    const std::string write = "write" + ofHistory(kMany);
    measureSeconds(read + ": " + peer, kListRepetitions,
                   [=]
                   {
                       const auto file = newFile();
                       const bool stored = storeList(file, kMany, utf8PathOf);
                       const auto unseen = newFile();
                       std::filesystem::rename(file, unseen);
                       return stored ? secondsIfDone([&] { return readList(unseen, kMany); }) : -1;
                   });
    measureSeconds(write + ": " + peer, kListRepetitions,
                   [=]
                   {
                       const auto file = newFile();
                       return secondsIfDone([&] { return storeList(file, kMany, utf8PathOf); });
                   });
    bench::addRatio({.what = read + " / " + peer,
                     .measured = read,
                     .base = read + ": " + peer,
                     .most = most,
                     .how = why});
    bench::addRatio({.what = write + ", none before / " + peer,
                     .measured = write + ", none before",
                     .base = write + ": " + peer,
                     .most = most,
                     .how = why});
}

void addListPeers()
{
    addPeer(
        "QSettings (INI)", bench::storeByQSettings, bench::readByQSettings, 1,
        "It writes a new file, has it brought to the disk and gives it the old one's name; it reads a file "
        "that this process has not seen before.");
    addPeer(
        "GKeyFile", bench::storeByGKeyFile, bench::readByGKeyFile, 0,
        "It writes as QSettings does. It is quicker, and has no limit: one text file has no checksums, no "
        "order of its own beside the names, and no journal, so that one changed value costs as much as all "
        "of them, and two processes overwrite each other's. Its list looks for no duplicates either.");
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
        ->Repetitions(bench::repetitions(kListRepetitions))
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
        bench::addRatio({many + " / 2 microseconds", many, "two microseconds", 0.12});
        bench::addRatio(
            {"look up, " + kind + ", at 100000 / at 1000", many, "look up, " + kind + ", list of 1000", 1.3});
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
                     "x", 1.75);
}
} // namespace

void addListBenchmarks()
{
    bench::startHost();
    addHistory(kFew, kFewRepetitions);
    addHistory(kMany, kListRepetitions);
    addHistory(kMost, kMostRepetitions);
    addSecondThousand();
    addBareCalls();
    addStoreAlone();
    addListPeers();
    addStoreRatios();
    addHistoryRatios("read", 1.15, 1.2, 1.4);
    addHistoryRatios("write", 1.15, 1.15, 1.3);
    addLookups();
    addMemory();
}
