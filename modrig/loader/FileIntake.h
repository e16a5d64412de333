// Files that a dialog is given, by a drop or from a file dialog: how many at once, which are kept, which may
// join the Startup Suite.
#pragma once

#include <vector>

#include "modrig/base/CStdStr.h"

namespace ModrigUtils
{
// More at once is taken for a slip of the mouse: a whole folder's contents, say.
inline constexpr std::size_t kMaxFilesAtOnce = 50;

// Whether there are too many files; message 37 then says so.
bool RefuseTooManyFiles(std::size_t count);

// The applications among the files that exist, each by the path it was found at, in order.
std::vector<CStdStr> AcceptedFiles(const std::vector<CStdStr>& paths);

// The same without those that the Startup Suite has already.
std::vector<CStdStr> FilesNewToStartupSuite(const std::vector<CStdStr>& paths);

// Whether the file is a local copy of one from the internet, gone at the next start; message 41 then says
// that it cannot join the Startup Suite.
bool RefuseTemporaryInternetFile(const CStdStr& path);

// Appends the files to the Startup Suite and says how many of them are in it now; those that were in it
// before count too.
void AddToStartupSuite(const std::vector<CStdStr>& paths);
} // namespace ModrigUtils
