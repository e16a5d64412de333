// The module's ordered list of wide strings: application paths, walked from head to tail.
//
// Beside the order the list keeps an index, so that "is this application in the list" need not walk it: lists
// of a hundred thousand entries are asked for every file that is loaded.
#pragma once

#include <cstdint>
#include <iterator>
#include <list>

#include "modrig/base/CStdStr.h"
#include "modrig/base/HashIndex.h"

class SplitPath;

class CStringList
{
    struct Entry
    {
        CStdStr text;
        std::uint64_t place; // grows from head to tail
    };
    using Entries = std::list<Entry>;

public:
    // Walks the texts from head to tail.
    class const_iterator
    {
    public:
        using iterator_category = std::forward_iterator_tag;
        using value_type = CStdStr;
        using difference_type = std::ptrdiff_t;
        using pointer = const CStdStr*;
        using reference = const CStdStr&;

        const_iterator() = default;
        reference operator*() const { return mEntry->text; }
        pointer operator->() const { return &mEntry->text; }
        const_iterator& operator++()
        {
            ++mEntry;
            return *this;
        }
        const_iterator operator++(int)
        {
            const_iterator before = *this;
            ++mEntry;
            return before;
        }
        friend bool operator==(const const_iterator&, const const_iterator&) = default;

    private:
        friend class CStringList;
        explicit const_iterator(Entries::const_iterator entry) : mEntry(entry) {}
        Entries::const_iterator mEntry;
    };

    CStringList() = default;
    // The index points into the list: a copy would need an index of its own, and nothing needs a copy.
    CStringList(const CStringList&) = delete;
    CStringList& operator=(const CStringList&) = delete;

    const_iterator begin() const { return const_iterator(mEntries.begin()); }
    const_iterator end() const { return const_iterator(mEntries.end()); }
    std::size_t GetCount() const { return mEntries.size(); }
    bool IsEmpty() const { return mEntries.empty(); }

    void AddTail(const CStdStr& text);
    void RemoveAll();

    // Adds the path unless an entry stands for the same application (see `HoldsApplication`). Answers the new
    // entry, or null.
    [[nodiscard]] const CStdStr* AddTailUnlessHeld(CStdStr path);

    // Erases the first entry that equals the text without regard to case. Answers whether there was one.
    [[nodiscard]] bool RemoveFirstNoCase(const CStdStr& text);

    // Whether an entry stands for the same application as the path (see `SplitPath` and `MatchesEntry`).
    [[nodiscard]] bool HoldsApplication(const CStdStr& path) const;

private:
    Entries::iterator Append(CStdStr text);
    void AddToIndex(Entries::iterator entry, const SplitPath& split, std::size_t pathHash);
    bool Holds(const SplitPath& target, std::size_t pathHash) const;
    bool HoldsUnder(std::size_t hash, const SplitPath& target) const;

    Entries mEntries;
    HashIndex<Entries::iterator> mIndex; // by the hash of what an entry is matched by
    bool mKnownByName = false;           // there was an entry that is known by its file name alone
    std::uint64_t mNextPlace = 0;
};

// The rule by which an entry stands for the same application as a path: an entry that is known by its file
// name alone matches on that; any other matches on file name and folder. Case never matters.
[[nodiscard]] bool MatchesEntry(const SplitPath& entry, const SplitPath& target);
