#include "host/lisp/LispLoads.h"

#include <algorithm>

#include "host/lisp/LispFile.h"
#include "host/lisp/LispMachine.h"

namespace tessel
{
namespace
{
// What Lisp says of a file begins with the file, which stands beside it already: "a.lsp:3: It is wrong.", or
// "Cannot load "a.lsp": it is a folder."
std::wstring reasonIn(const std::wstring& words, const std::wstring& path)
{
    const std::wstring refusal = refusalBeforeReason(path);
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

// An error that names no file came after one that was caught: what an expression does next is no file's
// fault.
bool LispLoads::isOfFile(const std::wstring& words) const
{
    return std::ranges::any_of(
        mFiles, [&](const File& file)
        { return words.starts_with(file.path) || words.starts_with(beginningOfRefusal(file.path)); });
}

void LispLoads::refused(const Outcome& admitted)
{
    if (!mFiles.empty())
        mFiles.back().failureCode = admitted.code();
}

int LispLoads::end(const Outcome& value)
{
    int code = 0;
    if (!value && (value.code() == LispMachine::kLeftByJump || isOfFile(value.sentence())) && !mFiles.empty())
    {
        const File& first = mFiles.front();
        code = first.failureCode;
        note(first, Failure{reasonIn(value.sentence(), first.path), code});
    }
    mFiles.clear();
    return code;
}
} // namespace tessel
