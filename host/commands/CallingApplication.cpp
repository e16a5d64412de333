#include "host/commands/CallingApplication.h"

#include <algorithm>

#include <tessel/tsed.h>

#include "host/text/Running.h"

namespace tessel
{
const std::wstring& CallingApplication::path() const
{
    static const std::wstring none;
    return mPaths.empty() ? none : mPaths.back();
}

bool CallingApplication::isAtWork(std::wstring_view path) const
{
    return std::ranges::find(mPaths, path) != mPaths.end();
}
} // namespace tessel

const wchar_t* tsedGetAppName()
{
    const auto* calls = tessel::running<tessel::CallingApplication>();
    return calls ? calls->path().c_str() : L"";
}
