// A registry file with bits that have flipped, and cut short: it reads as it was stored or is told to be
// damaged, and is left as it is.
#include <fstream>
#include <iterator>
#include <string>
#include <vector>

#include "host/registry/Registry.h"
#include "tests/fuzz/FuzzHost.h"

namespace
{
using tessel::Registry;

constexpr const wchar_t* kLists = L"Software\\Tessel\\R21\\Profiles\\Default\\Dialogs\\Modrig";
constexpr int kKeys = 4;
constexpr int kEntries = 40;
constexpr std::size_t kMostKeys = 1000; // what was stored has a dozen
constexpr std::size_t kChange = 3;      // bytes of the input for one flipped bit: its place and which it is

std::filesystem::path folder()
{
    return fuzzFolder() / "registry";
}

std::filesystem::path file()
{
    return folder() / "registry.db";
}

std::string content()
{
    std::ifstream stream(file(), std::ios::binary);
    return {std::istreambuf_iterator<char>(stream), {}};
}

// The bytes of a sound file with some lists in it.
std::string makeSound()
{
    std::filesystem::create_directories(folder());
    {
        Registry registry(file());
        for (int key = 0; key < kKeys; ++key)
            for (int entry = 0; entry < kEntries; ++entry)
                require(static_cast<bool>(registry.write(
                    std::wstring(kLists) + L"\\" + std::to_wstring(key), std::to_wstring(entry) + L"Entry",
                    L"/home/büro/applications/" + std::to_wstring(entry))));
        require(static_cast<bool>(registry.endOfCommand()));
    }
    return content();
}

std::string changed(std::string bytes, const std::uint8_t* data, std::size_t size)
{
    if (size > 0 && data[0] % 4 == 0) // down to half its length
        bytes.resize(bytes.size() - bytes.size() * data[0] / 512);
    for (std::size_t at = 1; at + kChange <= size; at += kChange)
    {
        const std::size_t place = (data[at] << 8 | data[at + 1]) % bytes.size();
        bytes[place] = static_cast<char>(bytes[place] ^ 1 << data[at + 2] % 8);
    }
    return bytes;
}

using Content = std::vector<std::wstring>; // names of keys, names and data of values

// Everything that can be read.
Content readAll(Registry& registry)
{
    std::vector<Registry::Key> keys = {Registry::kRoot};
    Content found;
    for (std::size_t next = 0; next < keys.size(); ++next)
    {
        require(keys.size() < kMostKeys);
        for (const Registry::Value& value : registry.values(keys[next]))
            found.insert(found.end(), {value.name, value.data});
        for (const std::wstring& name : registry.subKeys(keys[next]))
        {
            found.push_back(name);
            if (const Registry::Key child = registry.find(name, keys[next]); child != Registry::kNoKey)
                keys.push_back(child);
        }
        for (DWORD index = 0; registry.valueName(keys[next], index); ++index)
            require(index + 1 < kMostKeys);
    }
    return found;
}

// Whether a person has been told of something by the end of the first command.
bool isTold(Registry& registry)
{
    const std::wstring canStore = registry.canStore().sentence();
    const std::wstring notice = registry.notice().value_or(L"");
    const std::wstring ended = registry.endOfCommand().sentence();
    for (const std::wstring& sentence : {canStore, notice, ended})
        note(sentence.substr(0, sentence.find(L'/')) + sentence.substr(sentence.rfind(L':') + 1));
    return !canStore.empty() || !notice.empty() || !ended.empty();
}
} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    static const std::string sound = makeSound();
    static const Content stored = []
    {
        Registry registry(file());
        return readAll(registry);
    }();
    const std::string bytes = changed(sound, data, size);
    std::filesystem::remove_all(folder());
    std::filesystem::create_directories(folder());
    std::ofstream(file(), std::ios::binary) << bytes;
    {
        Registry registry(file());
        const Content read = readAll(registry);
        note(std::to_wstring(read.size()));
        const bool told = isTold(registry);
        require(bytes == sound ? !told && read == stored : told || read == stored);
    }
    require(content() == bytes);
    return 0;
}
