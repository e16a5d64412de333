// One of the lists that the module keeps in the registry, and what can be done with it there.
//
// Nothing here shows a window: what stands in the way is a sentence.
#pragma once

#include <optional>
#include <vector>

#include "modrig/lists/StoredList.h"

namespace ModrigUtils
{
struct KeptList
{
    const wchar_t* token; // its name for programs
    const StoredListNames& names;
    CStringList& files;
    unsigned nameText; // within a sentence
    unsigned inText;   // within one about what is in it
    unsigned oneAdded;
    unsigned manyAdded;
    unsigned oneRemoved;
    unsigned manyRemoved;
    bool isLoadedAtStart;
};

const KeptList& KeptStartupSuite();
const KeptList& KeptHistory();

// Reads what counts in this profile. Why some of it, or all, could not be read; empty when all was.
[[nodiscard]] CStdStr ReadKept(const KeptList& list);

// What a person has done to a list: a sentence about it, or why nothing was done.
struct Change
{
    CStdStr refused = {}; // empty where all went well
    CStdStr told = {};
};

// The changes concern `list.files` alone, as a whole or not at all; nothing is stored. Paths as they were
// typed.
[[nodiscard]] Change AddFiles(const KeptList& list, const std::vector<CStdStr>& typed);
[[nodiscard]] Change RemoveFiles(const KeptList& list, const std::vector<CStdStr>& typed);
[[nodiscard]] Change RemoveAllFiles(const KeptList& list);
// Of the Startup Suite: to a place from 1 on.
[[nodiscard]] Change MoveFile(const CStdStr& typed, const CStdStr& place);

// Where the administrator has laid down something else than these files; empty where nothing is in the way.
[[nodiscard]] CStdStr LaidDownInstead(const KeptList& list);
// Which of the entries are laid down by the administrator, in their order.
[[nodiscard]] std::vector<bool> WhichAreLaidDown(const KeptList& list);
} // namespace ModrigUtils
