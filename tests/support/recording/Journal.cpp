#include "tests/support/recording/Journal.h"

#include <algorithm>
#include <iterator>

void Journal::add(std::wstring_view call, std::initializer_list<Argument> arguments)
{
    std::wstring entry(call);
    entry += L'(';
    const wchar_t* separator = L"";
    for (const Argument& argument : arguments)
    {
        entry += separator + argument.text;
        separator = L", ";
    }
    mEntries.push_back(entry + L")");
}

std::vector<std::wstring> Journal::entriesOf(std::wstring_view call) const
{
    std::vector<std::wstring> found;
    std::copy_if(mEntries.begin(), mEntries.end(), std::back_inserter(found),
                 [call](const std::wstring& entry) { return entry.starts_with(call); });
    return found;
}
