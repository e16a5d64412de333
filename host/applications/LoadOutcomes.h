// How loading went in this session, file by file: for APPS, and for the summary of the start.
#pragma once

#include <chrono>
#include <cstddef>
#include <deque>
#include <functional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <utility>
#include <vector>

#include "host/text/Result.h"

namespace tessel
{
struct LoadOutcome
{
    std::wstring path; // as it was asked for
    Result<> loaded;   // why not is the end of a sentence, or sentences
    std::chrono::microseconds took{0};
};

class LoadOutcomes
{
public:
    using Clock = std::chrono::steady_clock;

    // Takes the place of what was noted of the path before.
    void note(const std::wstring& path, const Result<>& loaded, Clock::time_point begun);

    // From now on, or no longer, a summary is to come: a failure that is noted need not be told at once. What
    // is kept out has not failed, and no summary tells of it.
    void expectSummary(bool isToCome) { mExpectsSummary = isToCome; }
    bool willBeTold(int failureCode) const;

    // Is told of each outcome that is noted.
    void tellBy(std::function<void(const LoadOutcome&)> tell) { mTell = std::move(tell); }

    // Null for a path of which nothing was noted.
    const LoadOutcome* of(const std::wstring& path) const;

    // What was not loaded and has not been since, in the order in which it was first tried.
    std::vector<LoadOutcome> failed() const;

private:
    std::deque<LoadOutcome> mOutcomes;                           // which stay where they are
    std::unordered_map<std::wstring_view, LoadOutcome*> mByPath; // the texts are theirs
    bool mExpectsSummary = false;
    std::function<void(const LoadOutcome&)> mTell;
};
} // namespace tessel
