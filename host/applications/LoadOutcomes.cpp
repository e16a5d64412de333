#include "host/applications/LoadOutcomes.h"

#include <algorithm>
#include <iterator>

#include "host/applications/Admission.h"

namespace tessel
{
void LoadOutcomes::note(const std::wstring& path, const Result<>& loaded, Clock::time_point begun)
{
    const auto took = std::chrono::duration_cast<std::chrono::microseconds>(Clock::now() - begun);
    const auto [known, isNew] = mIndexes.try_emplace(path, mOutcomes.size());
    if (isNew)
        mOutcomes.push_back({path, loaded, took});
    else
        mOutcomes[known->second] = {path, loaded, took};
    if (mTell)
        mTell(mOutcomes[known->second]);
}

bool LoadOutcomes::willBeTold(int failureCode) const
{
    return mExpectsSummary && !Admission::isKeptOut(failureCode);
}

const LoadOutcome* LoadOutcomes::of(const std::wstring& path) const
{
    const auto known = mIndexes.find(path);
    return known == mIndexes.end() ? nullptr : &mOutcomes[known->second];
}

std::vector<LoadOutcome> LoadOutcomes::failed() const
{
    std::vector<LoadOutcome> result;
    std::ranges::copy_if(mOutcomes, std::back_inserter(result),
                         [](const LoadOutcome& outcome) { return !outcome.loaded; });
    return result;
}
} // namespace tessel
