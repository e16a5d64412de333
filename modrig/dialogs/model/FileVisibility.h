// Which files and folders the file panel shows.
#pragma once

#include <vector>

#include "modrig/base/CStdStr.h"

namespace ModrigUtils
{
// What the panel knows of a file, links resolved.
struct PanelFile
{
    CStdStr extension; // without the dot
    bool exists = false;
    bool isFolder = false;
    bool isPackage = false; // a folder that its user sees as one file
    bool isHostFolder = false;
};

// Whether the file shows under a filter with the given extensions. Folders always do, for the way through
// them; so does the host's own application folder, where the applications that come with the host are.
[[nodiscard]] bool IsShownInPanel(const PanelFile& file, bool packagesAreFolders,
                                  const std::vector<CStdStr>& extensions);
} // namespace ModrigUtils
