#include "host/console/Completion.h"

#include <algorithm>

#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
bool beginsWith(const std::wstring& name, std::wstring_view beginning)
{
    return equalIgnoringCase(std::wstring_view(name).substr(0, beginning.size()), beginning);
}

// The part of the first name that all names share, without regard to case.
std::wstring sharedBeginning(const std::vector<std::wstring>& names)
{
    std::wstring shared = names.front();
    while (!std::ranges::all_of(names, [&](const auto& name) { return beginsWith(name, shared); }))
        shared.pop_back();
    return shared;
}
} // namespace

std::optional<Completion> completeCommand(std::wstring_view line, const std::vector<std::wstring>& names)
{
    if (line.find_first_of(L" \t") != line.npos)
        return std::nullopt;
    Completion result;
    std::ranges::copy_if(names, std::back_inserter(result.candidates),
                         [&](const auto& name) { return beginsWith(name, line); });
    if (result.candidates.empty())
        return std::nullopt;
    result.text = sharedBeginning(result.candidates);
    if (result.candidates.size() > 1)
        return result;
    result.text += L' ';
    result.candidates.clear();
    return result;
}
} // namespace tessel
