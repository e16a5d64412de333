#include "host/commands/CallingApplication.h"

#include <algorithm>

#include <tessel/tsed.h>

#include "host/text/Running.h"
#include "host/text/Unicode.h"

namespace tessel
{
CallingApplication::Scope::Scope(CallingApplication& calls, const std::wstring& path, Deed deed,
                                 const std::wstring& detail)
    : mCalls(calls), mMark(calls.mMarker, deed, toUtf8(path), toUtf8(detail))
{
    mCalls.mPaths.push_back(path);
}

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
