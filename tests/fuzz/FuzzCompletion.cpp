// The Tab key with any beginning and any names: the first line is what is typed, the others are names; the
// second is also what Lisp stands before it.
#include <algorithm>
#include <cstdint>
#include <cstdlib>
#include <string>
#include <vector>

#include "host/console/Completion.h"
#include "host/text/Unicode.h"

namespace
{
void require(bool condition)
{
    if (!condition)
        std::abort();
}

bool begins(const std::wstring& text, const std::wstring& beginning)
{
    return tessel::equalIgnoringCase(text.substr(0, beginning.size()), beginning);
}

// Every name is a command, a variable, a file, a key, a symbol and a way of typing any command.
tessel::CompletionSources sourcesOf(const std::vector<std::wstring>& names)
{
    const auto all = [names](const auto&...)
    {
        return names;
    };
    const auto branches = [names](const std::wstring&)
    {
        std::vector<tessel::Branch> result;
        for (const auto& name : names)
            result.push_back({name, name.size() % 2 == 0});
        return result;
    };
    const auto usage = [names](const std::wstring&)
    {
        std::wstring ways = L"file | LIST key";
        for (const auto& name : names)
            ways += L" | " + name;
        return ways;
    };
    return {all, usage, all, branches, branches, all};
}

std::vector<std::wstring> linesOf(const std::wstring& text)
{
    std::vector<std::wstring> lines(1);
    for (const wchar_t character : text)
        if (character == L'\n')
            lines.emplace_back();
        else
            lines.back() += character;
    return lines;
}
} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    auto names = linesOf(tessel::toWide(std::string(data, data + size)));
    const std::wstring typed = names.front();
    names.erase(names.begin());
    const auto completion = tessel::complete(typed, sourcesOf(names), names.empty() ? L"" : names.front());
    if (!completion)
        return 0;
    require(completion->replaced <= typed.size());
    require(completion->candidates.size() != 1);
    for (const std::wstring& candidate : completion->candidates)
        require(std::ranges::any_of(names, [&](const auto& name) { return begins(candidate, name); }));
    return 0;
}
