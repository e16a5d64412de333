#include "host/applications/Bisection.h"

namespace tessel
{
Bisection::Bisection(std::size_t suspects) : mSuspects(suspects), mEnd(suspects)
{
}

Bisection::Bisection(std::size_t suspects, const std::vector<bool>& wereGood) : Bisection(suspects)
{
    for (const bool wasGood : wereGood)
        answer(wasGood);
}

std::size_t Bisection::startsLeft() const
{
    if (mVerdict != Verdict::kOpen)
        return 0;
    std::size_t starts = 1;
    for (std::size_t left = stillSuspected(); left > 1; left -= left / 2)
        ++starts;
    return starts;
}

bool Bisection::isLoaded(std::size_t suspect) const
{
    if (stillSuspected() > 1)
        return suspect >= mBegin && suspect < middle();
    return mEverGood && suspect == mBegin;
}

void Bisection::answer(bool wasGood)
{
    if (mVerdict != Verdict::kOpen)
        return;
    if (stillSuspected() > 1)
        return halve(wasGood);
    if (mEverGood)
        mVerdict = wasGood ? Verdict::kTogether : Verdict::kFound;
    else
        mVerdict = wasGood ? Verdict::kFound : Verdict::kNone;
}

void Bisection::halve(bool wasGood)
{
    const bool wasAlone = middle() - mBegin == 1;
    mEverGood = mEverGood || wasGood;
    (wasGood ? mBegin : mEnd) = middle();
    // There was trouble with it alone, and none without it.
    if (mEverGood && !wasGood && wasAlone)
        mVerdict = Verdict::kFound;
}
} // namespace tessel
