// Values by their hashes, of which several may be equal.
//
// All of it lies in few blocks of memory: a hundred thousand entries, each in a block of its own, would cost
// a start more than reading them from the disk. A look mostly touches one line of memory: where nothing
// stands under a hash, its slot says so, and the values are not looked at.
#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

template <class Value>
class HashIndex
{
public:
    void Add(std::size_t hash, const Value& value)
    {
        // A quarter of the slots stays empty, so that a look soon ends at one.
        if (4 * (mCount + 1) > 3 * mSlots.size())
            Grow();
        Put({Short(hash), PlaceFor(value)});
        ++mCount;
    }

    // The value stands under that hash.
    void Remove(std::size_t hash, const Value& value)
    {
        std::size_t at = Short(hash) & Mask();
        while (mSlots[at].hash != Short(hash) || mValues[mSlots[at].place] != value)
            at = After(at);
        mFree.push_back(mSlots[at].place);
        CloseGap(at);
        --mCount;
    }

    void Clear() { *this = HashIndex(); }

    // Asks memory for what the next look under that hash will touch, and does not wait for it.
    void Prefetch(std::size_t hash) const
    {
        if (!mSlots.empty())
            __builtin_prefetch(&mSlots[Short(hash) & Mask()]);
    }

    // Calls `visit` with the values under that hash, in no order, until it answers true. Whether it did. A
    // few of other hashes may be among them.
    template <class Visit>
    bool AnyUnder(std::size_t hash, Visit visit) const
    {
        if (mSlots.empty())
            return false;
        for (std::size_t at = Short(hash) & Mask(); mSlots[at].place != kNone; at = After(at))
            if (mSlots[at].hash == Short(hash) && visit(mValues[mSlots[at].place]))
                return true;
        return false;
    }

private:
    // Stands at the place that its hash says, or after it, with no empty one between.
    struct Slot
    {
        std::uint32_t hash = 0;
        std::uint32_t place = kNone; // of the value
    };

    static constexpr std::uint32_t kNone = UINT32_MAX;
    static constexpr std::size_t kFewest = 16; // slots; always a power of two

    static std::uint32_t Short(std::size_t hash)
    {
        const std::uint64_t whole = hash;
        return static_cast<std::uint32_t>(whole ^ (whole >> 32));
    }
    std::size_t Mask() const { return mSlots.size() - 1; }
    std::size_t After(std::size_t at) const { return (at + 1) & Mask(); }

    std::uint32_t PlaceFor(const Value& value)
    {
        if (mFree.empty())
        {
            mValues.push_back(value);
            return static_cast<std::uint32_t>(mValues.size() - 1);
        }
        const std::uint32_t place = mFree.back();
        mFree.pop_back();
        mValues[place] = value;
        return place;
    }

    void Put(const Slot& slot)
    {
        std::size_t at = slot.hash & Mask();
        while (mSlots[at].place != kNone)
            at = After(at);
        mSlots[at] = slot;
    }

    // What stands after a gap, up to the next one, moves into it unless that is before where its hash says.
    void CloseGap(std::size_t gap)
    {
        for (std::size_t at = After(gap); mSlots[at].place != kNone; at = After(at))
        {
            const std::size_t wanted = mSlots[at].hash & Mask();
            if (((at - wanted) & Mask()) < ((at - gap) & Mask()))
                continue;
            mSlots[gap] = mSlots[at];
            gap = at;
        }
        mSlots[gap] = {};
    }

    void Grow()
    {
        std::vector<Slot> before(mSlots.empty() ? kFewest : 2 * mSlots.size());
        before.swap(mSlots);
        for (const Slot& slot : before)
            if (slot.place != kNone)
                Put(slot);
    }

    std::vector<Slot> mSlots; // by the hash's low bits
    std::vector<Value> mValues;
    std::vector<std::uint32_t> mFree; // places in it
    std::size_t mCount = 0;
};
