#include "host/commands/TypedLine.h"

#include <utility>

namespace tessel
{
namespace
{
bool isBlank(wchar_t character)
{
    return character == L' ' || character == L'\t' || character == L'\r' || character == L'\n';
}
} // namespace

TypedLine takeApart(std::wstring_view line)
{
    TypedLine taken;
    OpenPart& part = taken.last;
    std::size_t start = 0;
    for (std::size_t at = 0; at < line.size(); ++at)
    {
        if (!part.isInQuotes && isBlank(line[at]))
        {
            if (start < at) // a pair of quotes with nothing between them is a part, too
                taken.parts.push_back(std::exchange(part.text, {}));
            start = at + 1;
        }
        else if (line[at] != L'"')
            part.text += line[at];
        else if (part.isInQuotes && line.substr(at).starts_with(L"\"\""))
            part.text += line[at++];
        else
            part.isInQuotes = !part.isInQuotes;
    }
    part.typed = line.substr(start);
    return taken;
}

std::vector<std::wstring> TypedLine::allParts() const
{
    std::vector<std::wstring> all = parts;
    if (!last.typed.empty())
        all.push_back(last.text);
    return all;
}

std::vector<std::wstring> splitLine(std::wstring_view line)
{
    return takeApart(line).allParts();
}

bool isForPrograms(std::wstring_view line)
{
    const auto parts = splitLine(line);
    return parts.size() > 1 && parts.back() == kForPrograms;
}

std::wstring asOpenPart(std::wstring_view text)
{
    std::wstring part = L"\"";
    for (const wchar_t character : text)
        part += character == L'"' ? std::wstring(L"\"\"") : std::wstring(1, character);
    return part;
}

std::wstring asPart(std::wstring_view text)
{
    return asOpenPart(text) + L"\"";
}
} // namespace tessel
