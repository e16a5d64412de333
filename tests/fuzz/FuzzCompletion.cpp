// The Tab key with any beginning and any names: the first line is what is typed, the others are names.
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
    const auto completion = tessel::completeCommand(typed, names);
    if (!completion)
        return 0;
    require(typed.find_first_of(L" \t") == typed.npos);
    require(begins(completion->text, typed));
    require(completion->candidates.size() != 1);
    for (const std::wstring& candidate : completion->candidates)
        require(begins(candidate, completion->text));
    return 0;
}
