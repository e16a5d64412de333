// Which application is being called: the owner of the entry point or of the command that runs now.
#pragma once

#include <deque>
#include <string>
#include <string_view>

#include "host/commands/RunningMarker.h"

namespace tessel
{
class CallingApplication
{
public:
    using Deed = RunningMarker::Deed;

    // Marks nothing.
    CallingApplication() = default;
    // Marks each call in the marker.
    explicit CallingApplication(RunningMarker& marker) : mMarker(marker) {}

    // Lasts as long as one call into an application. Calls nest: an application may load another one.
    class Scope
    {
    public:
        // An empty path stands for the host itself. The detail: which command.
        Scope(CallingApplication& calls, const std::wstring& path, Deed deed = Deed::kEntryPoint,
              const std::wstring& detail = {});
        ~Scope() { mCalls.mPaths.pop_back(); }
        Scope(const Scope&) = delete;
        Scope& operator=(const Scope&) = delete;

    private:
        CallingApplication& mCalls;
        RunningMarker::Scope mMark;
    };

    RunningMarker& marker() { return mMarker; }

    // The full path of the application that is being called, or an empty text outside of any call. The text
    // stays in its place until that call ends.
    const std::wstring& path() const;

    // Whether a call of that application has not returned yet, be it the innermost or not. Its code must
    // stay in the process until then.
    bool isAtWork(std::wstring_view path) const;

private:
    RunningMarker mNoMarker;
    RunningMarker& mMarker = mNoMarker;
    std::deque<std::wstring> mPaths; // a deque: what `path` gave out does not move when calls nest
};
} // namespace tessel
