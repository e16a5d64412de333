#include "modrig/base/CStringList.h"

#include <string_view>
#include <utility>

#include "modrig/base/CaseFolding.h"
#include "modrig/base/SplitPath.h"

namespace
{
constexpr std::wstring_view kBundle = L"bundle";
constexpr std::wstring_view kObjectDatabaseModule = L".omp";

// Object-database modules are the same application wherever they lie. The extension of a split path begins
// with its dot, so that "bundle" is never equal and bundles are told apart by their folders too: users keep
// several versions of a bundle in different folders, and adding the dot would make them one.
bool IsKnownByFileNameAlone(const SplitPath& entry)
{
    const std::wstring_view extension = entry.Extension();
    return EqualIgnoringCase(extension, kBundle) || EqualIgnoringCase(extension, kObjectDatabaseModule);
}

std::size_t MatchingHash(const CStdStr& entry)
{
    const SplitPath split(entry);
    return IsKnownByFileNameAlone(split) ? split.FileNameHash() : WholePathHash(entry);
}
} // namespace

bool MatchesEntry(const SplitPath& entry, const SplitPath& target)
{
    if (!entry.SameFileName(target))
        return false;
    return IsKnownByFileNameAlone(entry) || entry.SameFolder(target);
}

void CStringList::AddTail(const CStdStr& text)
{
    const auto entry = Append(text);
    AddToIndex(entry, SplitPath(entry->text), WholePathHash(entry->text));
}

// The index of a long list is in no cache of the processor's, and memory takes about as long to answer as
// everything takes that stands between asking and looking.
const CStdStr* CStringList::AddTailUnlessHeld(CStdStr path)
{
    const std::size_t pathHash = WholePathHash(path);
    mIndex.Prefetch(pathHash);
    const auto entry = Append(std::move(path));
    const SplitPath split(entry->text);
    if (Holds(split, pathHash))
    {
        mEntries.erase(entry);
        return nullptr;
    }
    AddToIndex(entry, split, pathHash);
    return &entry->text;
}

CStringList::Entries::iterator CStringList::Append(CStdStr text)
{
    return mEntries.insert(mEntries.end(), Entry{std::move(text), mNextPlace++});
}

void CStringList::AddToIndex(Entries::iterator entry, const SplitPath& split, std::size_t pathHash)
{
    const bool knownByName = IsKnownByFileNameAlone(split);
    mKnownByName = mKnownByName || knownByName;
    mIndex.Add(knownByName ? split.FileNameHash() : pathHash, entry);
}

void CStringList::RemoveAll()
{
    mKnownByName = false;
    mIndex.Clear();
    mEntries.clear();
}

bool CStringList::RemoveFirstNoCase(const CStdStr& text)
{
    // Texts that are equal without regard to case are split alike, so that all of them stand under one hash.
    const std::size_t hash = MatchingHash(text);
    auto first = mEntries.end();
    mIndex.AnyUnder(hash,
                    [&](Entries::iterator candidate)
                    {
                        const bool earlier = first == mEntries.end() || candidate->place < first->place;
                        if (earlier && candidate->text.EqualsNoCase(text))
                            first = candidate;
                        return false; // all of them are looked at
                    });
    if (first == mEntries.end())
        return false;
    mIndex.Remove(hash, first);
    mEntries.erase(first);
    return true;
}

bool CStringList::HoldsApplication(const CStdStr& path) const
{
    if (IsEmpty())
        return false;
    return Holds(SplitPath(path), WholePathHash(path));
}

bool CStringList::Holds(const SplitPath& target, std::size_t pathHash) const
{
    return HoldsUnder(pathHash, target) || (mKnownByName && HoldsUnder(target.FileNameHash(), target));
}

bool CStringList::HoldsUnder(std::size_t hash, const SplitPath& target) const
{
    return mIndex.AnyUnder(hash, [&](Entries::iterator candidate)
                           { return MatchesEntry(SplitPath(candidate->text), target); });
}
