#include "host/console/FolderContent.h"

#include <algorithm>
#include <filesystem>

#include "host/platform/HomeFolder.h"
#include "host/text/TerminalText.h"
#include "host/text/Unicode.h"

namespace tessel
{
std::vector<Branch> contentOfFolder(const std::wstring& folder)
{
    const std::filesystem::path path = folder.empty() ? "." : withHomeFolder(toUtf8(folder));
    std::vector<Branch> content;
    std::error_code unreadable;
    for (std::filesystem::directory_iterator entry(path, unreadable), end; !unreadable && entry != end;
         entry.increment(unreadable))
    {
        const std::wstring name = toWide(entry->path().filename().string());
        std::error_code gone;
        if (forTerminal(name) == name)
            content.push_back({name, entry->is_directory(gone)});
    }
    std::ranges::sort(content, {}, &Branch::name);
    return content;
}
} // namespace tessel
