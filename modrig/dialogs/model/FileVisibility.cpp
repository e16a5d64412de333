#include "modrig/dialogs/model/FileVisibility.h"

#include <algorithm>

namespace ModrigUtils
{
namespace
{
constexpr const wchar_t* kApplicationFolder = L"app";
}

bool IsShownInPanel(const PanelFile& file, bool packagesAreFolders, const std::vector<CStdStr>& extensions)
{
    if (!file.exists)
        return false;
    if (file.isFolder && (packagesAreFolders || !file.isPackage))
        return true;
    if (std::any_of(extensions.begin(), extensions.end(),
                    [&file](const CStdStr& extension) { return extension.EqualsNoCase(file.extension); }))
        return true;
    return file.isHostFolder && file.extension.EqualsNoCase(CStdStr(kApplicationFolder));
}
} // namespace ModrigUtils
