#include "host/lisp/LispLoads.h"

#include <algorithm>
#include <utility>

#include "host/lisp/LispMachine.h"

namespace tessel
{
void LispLoads::begin()
{
    mFiles.clear();
    mFailed.reset();
}

LispLoads::Files::iterator LispLoads::lastOf(const std::wstring& path)
{
    const auto found =
        std::find_if(mFiles.rbegin(), mFiles.rend(), [&](const File& file) { return file.path == path; });
    return found == mFiles.rend() ? mFiles.end() : std::prev(found.base());
}

void LispLoads::note(const File& file) const
{
    if (mOutcomes)
        mOutcomes->note(file.path, file.loaded, file.begun);
}

// Files after it in the row have failed, and the one that loaded them went on without them.
void LispLoads::loaded(const std::wstring& path)
{
    const auto file = lastOf(path);
    if (file == mFiles.end())
        return;
    note(*file);
    mFiles.erase(file, mFiles.end());
}

void LispLoads::refused(const Failure& reason)
{
    if (!mFiles.empty())
        mFiles.back().loaded = reason;
}

void LispLoads::failed(const std::wstring& path, const std::wstring& words)
{
    const auto file = lastOf(path);
    if (file == mFiles.end())
        return;
    mFailed = *file;
    if (!words.empty())
        mFailed->loaded = Failure{words};
}

int LispLoads::end(const Outcome& value)
{
    if (!value && value.code() == LispMachine::kLeftByJump && !mFiles.empty())
        failed(mFiles.front().path, value.sentence()); // Lisp could not say so any more
    if (value || !mFailed)
        return 0;
    note(*mFailed);
    return mFailed->loaded.code();
}
} // namespace tessel
