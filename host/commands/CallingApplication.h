// Which application is being called: the owner of the entry point or of the command that runs now.
#pragma once

#include <deque>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "host/commands/RunningMarker.h"

namespace tessel
{
// One command of an application while it runs: what it was typed with, and what it says of itself.
struct CommandCall
{
    const std::vector<std::wstring>& arguments;
    std::optional<std::wstring> failure = {}; // an empty one: it does not take these arguments
};

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
        // An empty path stands for the host itself. The detail: which command. The command is the caller's.
        Scope(CallingApplication& calls, const std::wstring& path, Deed deed = Deed::kEntryPoint,
              const std::wstring& detail = {}, CommandCall* command = nullptr);
        ~Scope() { mCalls.mCalled.pop_back(); }
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

    // The command that is being called; null while an entry point is, or nothing.
    CommandCall* command() const;

    // Whether a call of that application has not returned yet, be it the innermost or not. Its code must
    // stay in the process until then.
    bool isAtWork(std::wstring_view path) const;

private:
    RunningMarker mNoMarker;
    RunningMarker& mMarker = mNoMarker;
    struct Called
    {
        std::wstring path;
        CommandCall* command;
    };
    std::deque<Called> mCalled; // a deque: what `path` gave out does not move when calls nest
};
} // namespace tessel
