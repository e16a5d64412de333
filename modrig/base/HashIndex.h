// Values by their hashes, of which several may be equal.
//
// All of it lies in two blocks of memory: a hundred thousand entries, each in a block of its own, would cost
// a start more than reading them from the disk.
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
        if (mNodes.size() == mFirst.size())
            Grow();
        std::uint32_t& first = FirstOf(hash);
        const Node node{hash, value, first};
        if (mFree == kNone)
        {
            first = static_cast<std::uint32_t>(mNodes.size());
            mNodes.push_back(node);
            return;
        }
        first = mFree;
        mFree = mNodes[first].next;
        mNodes[first] = node;
    }

    // The value stands under that hash.
    void Remove(std::size_t hash, const Value& value)
    {
        std::uint32_t* link = &FirstOf(hash);
        while (mNodes[*link].value != value)
            link = &mNodes[*link].next;
        const std::uint32_t gone = *link;
        *link = mNodes[gone].next;
        mNodes[gone].next = mFree;
        mFree = gone;
    }

    void Clear() { *this = HashIndex(); }

    // Calls `visit` with the values under that hash, in no order, until it answers true. Whether it did.
    template <class Visit>
    bool AnyUnder(std::size_t hash, Visit visit) const
    {
        if (mFirst.empty())
            return false;
        for (std::uint32_t at = mFirst[hash & (mFirst.size() - 1)]; at != kNone; at = mNodes[at].next)
            if (mNodes[at].hash == hash && visit(mNodes[at].value))
                return true;
        return false;
    }

private:
    struct Node
    {
        std::size_t hash;
        Value value;
        std::uint32_t next; // of the same place, or of those that are free
    };

    static constexpr std::uint32_t kNone = UINT32_MAX;
    static constexpr std::size_t kFewest = 16; // places; always a power of two

    std::uint32_t& FirstOf(std::size_t hash) { return mFirst[hash & (mFirst.size() - 1)]; }

    // As many places again as there are nodes, none of which is free.
    void Grow()
    {
        if (mFree != kNone)
            return;
        mFirst.assign(mFirst.empty() ? kFewest : 2 * mFirst.size(), kNone);
        for (std::uint32_t at = 0; at < mNodes.size(); ++at)
        {
            std::uint32_t& first = FirstOf(mNodes[at].hash);
            mNodes[at].next = first;
            first = at;
        }
    }

    std::vector<Node> mNodes;
    std::vector<std::uint32_t> mFirst; // by the hash's low bits
    std::uint32_t mFree = kNone;
};
