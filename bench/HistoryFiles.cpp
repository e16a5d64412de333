#include "bench/HistoryFiles.h"

#include <cstdlib>
#include <filesystem>
#include <fstream>

#include "bench/Session.h"
#include "modrig/lists/Globals.h"

namespace bench
{
namespace
{
constexpr std::size_t kInEachFolder = 100;
// A process that is started for one measurement takes the files of the one that starts it.
constexpr char kGivenFolder[] = "MODRIG_BENCH_HISTORY_FILES";

std::filesystem::path folderOf(Files files)
{
    if (files == Files::kGone)
        return "/home/user/Applications";
    const char* given = std::getenv(kGivenFolder);
    return given ? std::filesystem::path(given) : workFolder() / "Applications";
}

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
        std::ofstream(path).close(); // empty: taking back the block of each would take minutes
    }
}
} // namespace

void makeHistoryFiles(std::size_t count, Files files)
{
    if (files == Files::kGone)
        return;
    const std::filesystem::path folder = folderOf(files);
    makeFiles(folder, count);
    setenv(kGivenFolder, folder.c_str(), 1);
}

std::string historyFile(std::size_t number, Files files)
{
    return pathOf(folderOf(files), number).string();
}

void setHistory(std::size_t count, Files files)
{
    gHistoryList.RemoveAll();
    for (std::size_t number = 0; number < count; ++number)
        gHistoryList.AddTail(wide(historyFile(number, files)));
}
} // namespace bench
