// A list as it stands in the registry: a sub-key of the module key with the count of entries and one numbered
// value per entry, from 1.
#pragma once

#include <functional>

#include "modrig/base/CStringList.h"

namespace ModrigUtils
{
// Where and under which names a list is stored.
struct StoredListNames
{
    const wchar_t* subKey;   // "History"
    const wchar_t* count;    // "NumHistory"
    const wchar_t* entryEnd; // "History": of "1History", "2History"
};

inline constexpr StoredListNames kStoredHistory = {L"History", L"NumHistory", L"History"};
inline constexpr StoredListNames kStoredStartupSuite = {L"Startup", L"NumStartup", L"Startup"};

// The key of a list in the profile that is the current one, and the value of an entry, from 1.
[[nodiscard]] CStdStr SubKeyOf(const StoredListNames& names);
[[nodiscard]] CStdStr EntryName(const StoredListNames& names, long index);

// Replaces the list with what is stored. Duplicates are skipped. The list ends at the first gap in the
// numbering. The count is of attempts: each that fails, where a later one succeeds, costs an entry at the
// end. `appended` is called after every entry that has joined the list. Answers how many entries were read,
// duplicates too.
long ReadStoredList(const StoredListNames& names, CStringList& list,
                    const std::function<void(const CStdStr& path)>& appended);

// Replaces what is stored with the list. On failure the store may hold a part of the list, unless the host
// undoes it.
[[nodiscard]] bool StoreList(const StoredListNames& names, const CStringList& list);
// The same; a failure is told in a message box.
void WriteStoredList(const StoredListNames& names, const CStringList& list);
} // namespace ModrigUtils
