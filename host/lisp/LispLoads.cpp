#include "host/lisp/LispLoads.h"

#include <algorithm>

namespace tessel
{
namespace
{
// What Lisp says of a file begins with the file, which stands beside it already: "a.lsp:3: It is wrong.", or
// "Cannot load "a.lsp": it is a folder."
std::wstring reasonIn(const std::wstring& words, const std::wstring& path)
{
    const std::wstring refusal = L"Cannot load \"" + path + L"\": ";
    if (words.starts_with(refusal))
        return words.substr(refusal.size(), words.find_last_not_of(L'.') + 1 - refusal.size());
    const std::wstring place = path + L":";
    return words.starts_with(place) ? L"line " + words.substr(place.size()) : words;
}
} // namespace

void LispLoads::note(const File& file, const Result<>& loaded) const
{
    if (mOutcomes)
        mOutcomes->note(file.path, loaded, file.begun);
}

// Files after it in the row have failed, and the one that loaded them went on without them.
void LispLoads::loaded(const std::wstring& path)
{
    const auto found =
        std::find_if(mFiles.rbegin(), mFiles.rend(), [&](const File& file) { return file.path == path; });
    if (found == mFiles.rend())
        return;
    note(*found, {});
    mFiles.erase(std::prev(found.base()), mFiles.end());
}

void LispLoads::end(const Outcome& value)
{
    if (!value && !mFiles.empty())
        note(mFiles.front(), Failure{reasonIn(value.sentence(), mFiles.front().path)});
    mFiles.clear();
}
} // namespace tessel
