// Finds the one among several applications that makes trouble, by starts with some of them only. A person
// says after each whether the trouble was there.
//
// At each start half of those that are still suspected are loaded, and none of the other suspects: trouble is
// then the loaded half's. The last start makes sure of the one that is left: without any application the
// trouble must be gone, or with this one alone it must be there. That makes log2(n) starts, rounded up, and
// one more. Where each of two applications makes trouble by itself, one of them is found.
#pragma once

#include <cstddef>
#include <vector>

namespace tessel
{
class Bisection
{
public:
    enum class Verdict
    {
        kOpen,
        kFound,   // `culprit`
        kNone,    // the trouble is there without them
        kTogether // it takes several of them
    };

    // With all of them there was trouble. At least one.
    explicit Bisection(std::size_t suspects);
    // As it stood after these answers, from the first on. More than it takes are passed over.
    Bisection(std::size_t suspects, const std::vector<bool>& wereGood);

    std::size_t suspects() const { return mSuspects; }
    std::size_t stillSuspected() const { return mEnd - mBegin; }
    // How many starts it takes at most from here on.
    std::size_t startsLeft() const;

    // Whether the suspect is loaded at the start that is to be judged next.
    bool isLoaded(std::size_t suspect) const;
    // The start is judged.
    void answer(bool wasGood);

    Verdict verdict() const { return mVerdict; }
    std::size_t culprit() const { return mBegin; }

private:
    std::size_t middle() const { return mBegin + (mEnd - mBegin) / 2; }
    void halve(bool wasGood);

    std::size_t mSuspects;
    std::size_t mBegin = 0; // those still suspected
    std::size_t mEnd;
    bool mEverGood = false;
    Verdict mVerdict = Verdict::kOpen;
};
} // namespace tessel
