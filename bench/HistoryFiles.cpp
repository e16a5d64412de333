#include "bench/HistoryFiles.h"

#include <algorithm>
#include <filesystem>
#include <fstream>

#include "bench/Session.h"
#include "modrig/lists/Globals.h"

namespace bench
{
namespace
{
constexpr std::size_t kInEachFolder = 100;

std::filesystem::path pathOf(const std::filesystem::path& folder, std::size_t number)
{
    return folder / ("library" + std::to_string(number / kInEachFolder)) /
           ("tool" + std::to_string(number) + ".lsp");
}

void makeFiles(const std::filesystem::path& folder, std::size_t count)
{
    static std::size_t made = 0;
    for (; made < count; ++made)
    {
        const auto path = pathOf(folder, made);
        if (made % kInEachFolder == 0)
            std::filesystem::create_directories(path.parent_path());
        std::ofstream(path).put('(');
    }
}
} // namespace

std::vector<std::string> historyFiles(std::size_t count, Files files)
{
    const std::filesystem::path folder =
        files == Files::kThere ? workFolder() / "Applications" : "/home/user/Applications";
    if (files == Files::kThere)
        makeFiles(folder, count);
    std::vector<std::string> paths;
    for (std::size_t number = 0; number < count; ++number)
        paths.push_back(pathOf(folder, number).string());
    return paths;
}

void setHistory(const std::vector<std::string>& paths)
{
    gHistoryList.RemoveAll();
    for (const std::string& path : paths)
        gHistoryList.AddTail(wide(path));
}
} // namespace bench
