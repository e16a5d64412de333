#include "tests/host/registry/StoredList.h"

#include <algorithm>
#include <string_view>
#include <vector>

#include <sqlite3.h>

#include "host/text/Unicode.h"

using tessel::Registry;

const wchar_t* const kListKey = L"Software\\Tessel\\R21\\Profiles\\Default\\Dialogs\\Modrig\\History";

namespace
{
constexpr const wchar_t* kCount = L"NumHistory";
constexpr int kTorn = -1;

std::wstring entryName(int number)
{
    return std::to_wstring(number) + L"History";
}

std::wstring entryData(int generation, int number, std::size_t length)
{
    std::wstring text = std::to_wstring(generation) + L" /büro/" + std::to_wstring(number);
    text.resize(std::max(length, text.size()), L'x');
    return text;
}

bool removeOld(Registry& registry)
{
    const Registry::Key key = registry.find(kListKey);
    if (key == Registry::kNoKey)
        return true;
    for (const auto& value : registry.values(key))
        if (!registry.removeValue(key, value.name))
            return false;
    return true;
}

bool isEntry(const Registry::Value& value, int generation, int number)
{
    const std::wstring start = entryData(generation, number, 0);
    const std::wstring_view data = value.data;
    return value.name == entryName(number) && data.starts_with(start) &&
           data.substr(start.size()).find_first_not_of(L'x') == data.npos;
}

int generationIn(const std::vector<Registry::Value>& values)
{
    if (values.empty())
        return 0;
    if (values.back().name != kCount)
        return kTorn;
    const std::wstring& counted = values.back().data;
    const int generation = std::stoi(counted);
    const auto count = static_cast<std::size_t>(std::stoi(counted.substr(counted.find(L' '))));
    if (count != values.size() - 1)
        return kTorn;
    for (std::size_t i = 0; i < count; ++i)
        if (!isEntry(values[i], generation, static_cast<int>(i) + 1))
            return kTorn;
    return generation;
}
} // namespace

bool rewriteList(Registry& registry, int generation, int count, std::size_t entryLength)
{
    return removeOld(registry) && writeList(registry, generation, count, entryLength);
}

bool writeList(Registry& registry, int generation, int count, std::size_t entryLength)
{
    for (int number = 1; number <= count; ++number)
        if (!registry.write(kListKey, entryName(number), entryData(generation, number, entryLength)))
            return false;
    const auto counted =
        registry.write(kListKey, kCount, std::to_wstring(generation) + L" " + std::to_wstring(count));
    return static_cast<bool>(counted);
}

int generationOf(Registry& registry)
{
    const Registry::Key key = registry.find(kListKey);
    return generationIn(key == Registry::kNoKey ? std::vector<Registry::Value>() : registry.values(key));
}

int generationInOneLook(const std::filesystem::path& file)
{
    sqlite3* database = nullptr;
    sqlite3_stmt* values = nullptr;
    sqlite3_open(file.c_str(), &database);
    constexpr const char* kValues = "SELECT value.name, data FROM value JOIN key ON key.id = value.key"
                                    " WHERE key.fold = 'history' ORDER BY seq";
    sqlite3_prepare_v2(database, kValues, -1, &values, nullptr);
    const auto text = [&values](int column)
    {
        return tessel::toWide(reinterpret_cast<const char*>(sqlite3_column_text(values, column)));
    };
    std::vector<Registry::Value> found;
    while (sqlite3_step(values) == SQLITE_ROW)
        found.push_back({text(0), text(1)});
    sqlite3_finalize(values);
    sqlite3_close(database);
    return generationIn(found);
}
