#include "host/applications/LoadOutcomes.h"

#include <algorithm>
#include <iterator>

#include "host/applications/Admission.h"

namespace tessel
{
void LoadOutcomes::note(const std::wstring& path, const Result<>& loaded, Clock::time_point begun)
{
    const auto took = std::chrono::duration_cast<std::chrono::microseconds>(Clock::now() - begun);
    const auto known = mByPath.find(path);
    LoadOutcome& outcome = known == mByPath.end() ? mOutcomes.emplace_back() : *known->second;
    if (known == mByPath.end())
    {
        outcome.path = path;
        mByPath.emplace(outcome.path, &outcome);
    }
    outcome.loaded = loaded;
    outcome.took = took;
    if (mTell)
        mTell(outcome);
}

bool LoadOutcomes::willBeTold(int failureCode) const
{
    return mExpectsSummary && !Admission::isKeptOut(failureCode);
}

const LoadOutcome* LoadOutcomes::of(const std::wstring& path) const
{
    const auto known = mByPath.find(path);
    return known == mByPath.end() ? nullptr : known->second;
}

std::vector<LoadOutcome> LoadOutcomes::failed() const
{
    std::vector<LoadOutcome> result;
    std::ranges::copy_if(mOutcomes, std::back_inserter(result),
                         [](const LoadOutcome& outcome) { return !outcome.loaded; });
    return result;
}
} // namespace tessel
