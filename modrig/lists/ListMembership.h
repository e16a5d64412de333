// What is in the module's lists: asked whole or by path, and taken out.
#pragma once

#include "modrig/base/CStringList.h"

namespace ModrigUtils
{
// The lists as they are shown, in their order.
[[nodiscard]] const CStringList& StartupSuiteFiles();
[[nodiscard]] const CStringList& HistoryFiles();

// Whether the list has an entry for the application at the path: the same folder and file name in any case,
// or, for object-database modules (.omp), the same file name wherever it lies. A path that is too long to be
// taken apart stands for itself only.
[[nodiscard]] bool FoundinSpecificList(const CStdStr& path, const CStringList& list);

[[nodiscard]] bool FoundinStartupList(const CStdStr& path);
[[nodiscard]] bool FoundinHistoryList(const CStdStr& path);
[[nodiscard]] bool FoundinLoadedList(const CStdStr& path);

// Whether the path names a Lisp file (.lsp, .rpk, .qbc) that is in the list of loaded applications.
[[nodiscard]] bool IsALispAppFoundinList(const CStdStr& path);

// Erases the first entry that equals the whole path without regard to case, if there is one. The rule for
// object-database modules does not apply here.
void RemoveInSpecificList(const CStdStr& path, CStringList& list);
} // namespace ModrigUtils
