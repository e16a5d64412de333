// Files that a dialog is given, by a drop or from a file dialog: how many at once, which are kept, which may
// join the Startup Suite.
#pragma once

#include <functional>
#include <vector>

#include "modrig/base/CStdStr.h"

namespace ModrigUtils
{
// More at once is taken for a slip of the mouse: a whole folder's contents, say.
inline constexpr std::size_t kMaxFilesAtOnce = 50;

// Whether there are too many files; kTooManyFiles then says so.
[[nodiscard]] bool RefuseTooManyFiles(std::size_t count);

// The applications among the files that exist, each by the path it was found at, in order. None of too many
// files; kTooManyFiles then says so.
[[nodiscard]] std::vector<CStdStr> AcceptedFiles(const std::vector<CStdStr>& paths);

// The same without those that the Startup Suite has already.
[[nodiscard]] std::vector<CStdStr> FilesNewToStartupSuite(const std::vector<CStdStr>& paths);

// Whether the file is a local copy of one from the internet, gone at the next start; kTemporaryInternetFile
// then says that it cannot join the Startup Suite.
[[nodiscard]] bool RefuseTemporaryInternetFile(const CStdStr& path);

// Appends the files to the Startup Suite and says how many of them are in it now; those that were in it
// before count too.
void AddToStartupSuite(const std::vector<CStdStr>& paths);

// A table that shows the Startup Suite, as far as files that join the Suite concern it. Files are told by
// their index.
struct StartupSuiteTable
{
    std::function<bool(std::size_t index)> hasRow;
    // Called right before the file joins the list, so that table and list are in step after each.
    std::function<void(std::size_t index)> addRow;
};

// Appends the files that the table has no row for to the Startup Suite, silently: the user sees them come. A
// temporary copy of a file from the internet is refused with kTemporaryInternetFile. Answers how many files
// have joined.
[[nodiscard]] std::size_t AddToShownStartupSuite(const std::vector<CStdStr>& paths,
                                                 const StartupSuiteTable& table);
} // namespace ModrigUtils
